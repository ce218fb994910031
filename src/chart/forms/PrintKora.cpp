#include "chart/forms/PrintKora.h"

#include <QComboBox>
#include <QGridLayout>
#include <QLabel>
#include <QLineEdit>
#include <QSpinBox>

#include "base/runtime_error.h"
#include "base/text.h"
#include "chart/forms/printer_list.h"
#include "platform/qt/form_parts.h"
#include "platform/qt/qt_printer.h"

namespace kora {
namespace {

constexpr int kMostCopies = 99;

}  // namespace

PrintKora::PrintKora(const PrintServices& services, PrintChoice& choice, QWidget* parent)
    : QDialog(parent), services_(services), choice_(choice) {
  setObjectName("PrintKora");
  setWindowTitle("Print Chart");
  choice_.PrintCancelled = true;
  combo1_ = NewPrinterList(this, services_.printer);
  text1_ = new QSpinBox(this);
  text1_->setObjectName("Text1");
  text1_->setRange(1, kMostCopies);
  text2_ = NewField(this, "Text2", 36, 250);
  text2_->setText(ToQt(choice_.pdfFile));

  auto* grid = new QGridLayout(this);
  grid->addWidget(NewLabel(this, "P&rinter", combo1_), 0, 0);
  grid->addWidget(combo1_, 0, 1, 1, 2);
  grid->addWidget(NewLabel(this, "&Number of copies", text1_), 1, 0);
  grid->addWidget(text1_, 1, 1);
  grid->addWidget(NewLabel(this, "&File", text2_), 2, 0);
  grid->addWidget(text2_, 2, 1, 1, 2);
  grid->setColumnStretch(2, 1);
  grid->setRowStretch(3, 1);
  auto* buttons = new ButtonRow(this);
  buttons->Add("Command1", "&Print", [this] { Proceed(); });
  buttons->Add("Command2", "&Cancel", [this] { reject(); });
  grid->addLayout(buttons, 4, 0, 1, 3);
  connect(combo1_, &QComboBox::currentIndexChanged, this, [this] { PrinterChosen(); });
  PrinterChosen();
  QWidget* first = IsPdf() ? static_cast<QWidget*>(text2_) : text1_;
  first->setFocus();
  text1_->selectAll();
}

bool PrintKora::IsPdf() const {
  return combo1_->currentText() == ToQt(QtPrinter::kPdfPrinter);
}

// A file has no copies, and a queue no file.
void PrintKora::PrinterChosen() {
  text1_->setEnabled(!IsPdf());
  text2_->setEnabled(IsPdf());
}

void PrintKora::Proceed() {
  Dialogs& dialogs = services_.dialogs;
  if (combo1_->currentIndex() < 0) return dialogs.Message(kNoPrinter, kPrinterPage);
  std::string file;
  if (IsPdf()) {
    file = std::string(Trim(text2_->text().toStdString()));
    if (file.size() < 5 || !LCase(file).ends_with(".pdf"))
      return dialogs.Message("File name invalid", windowTitle().toStdString());
    if (services_.files.CheckFile(file) &&
        dialogs.Ask(file + " already exists - Overwrite", windowTitle().toStdString(),
                    Buttons::kOkCancel) != Answer::kOk)
      return;
  }
  try {
    services_.printer.SetDevice(combo1_->currentText().toStdString());
  } catch (const RunTimeError& e) {
    return dialogs.Message(std::string("There is an unexpected error - ") + e.what(), "Error");
  }
  choice_.PrintCancelled = false;
  choice_.PrintCopies = IsPdf() ? std::int16_t(1) : std::int16_t(text1_->value());
  if (IsPdf()) choice_.pdfFile = file;
  accept();
}

void PrintKora::reject() {
  choice_.PrintCancelled = true;
  QDialog::reject();
}

}  // namespace kora
