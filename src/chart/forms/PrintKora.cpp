#include "chart/forms/PrintKora.h"

#include <QCheckBox>
#include <QComboBox>
#include <QFileDialog>
#include <QFileInfo>
#include <QGridLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QSpinBox>

#include "base/runtime_error.h"
#include "base/text.h"
#include "chart/forms/printer_list.h"
#include "platform/qt/form_parts.h"
#include "platform/qt/modal.h"
#include "platform/qt/qt_printer.h"

namespace kora {
namespace {

constexpr int kMostCopies = 99;

// A path of the machine is taken as well as one of the program.
std::string FileOf(const Files& files, const QString& typed) {
  const std::string name(Trim(typed.toStdString()));
  return name.starts_with('/') ? files.DosPath(name) : name;
}

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
  browse_ = new QPushButton("&Browse...", this);
  browse_->setObjectName("Command3");
  browse_->setAutoDefault(false);
  grid->addWidget(browse_, 2, 3);
  connect(browse_, &QPushButton::clicked, this, [this] { Browse(); });
  dark_ = new QCheckBox("&Dark colours on white paper", this);
  dark_->setObjectName("Check1");
  dark_->setChecked(services_.settings.charts.DarkPaper);
  grid->addWidget(dark_, 3, 1, 1, 2);
  grid->setColumnStretch(2, 1);
  grid->setRowStretch(4, 1);
  auto* buttons = new ButtonRow(this);
  buttons->Add("Command1", "&Print", [this] { Proceed(); });
  buttons->Add("Command2", "&Cancel", [this] { reject(); });
  grid->addLayout(buttons, 5, 0, 1, 4);
  connect(combo1_, &QComboBox::currentIndexChanged, this, [this] { PrinterChosen(); });
  PrinterChosen();
  QWidget* first = IsPdf() ? static_cast<QWidget*>(text2_) : text1_;
  first->setFocus();
  text1_->selectAll();
}

bool PrintKora::IsPdf() const { return combo1_->currentText() == ToQt(QtPrinter::kPdfPrinter); }

// A file has no copies, and a queue no file.
void PrintKora::PrinterChosen() {
  text1_->setEnabled(!IsPdf());
  text2_->setEnabled(IsPdf());
  browse_->setEnabled(IsPdf());
}

void PrintKora::Browse() {
  std::string standing;
  try {
    standing = services_.files.HostPath(FileOf(services_.files, text2_->text()));
  } catch (const RunTimeError&) {
    // What is no path is no place to begin at.
  }
  std::optional<std::string> chosen;
  if (choice_.pickPdf) {
    chosen = choice_.pickPdf(standing);
  } else {
    const QFileInfo file(QString::fromStdString(standing));
    Modal<QFileDialog> dialog(this, windowTitle(), file.path(), "PDF files (*.pdf)");
    dialog->setAcceptMode(QFileDialog::AcceptSave);
    dialog->setOption(QFileDialog::DontConfirmOverwrite);  // the question is the form's own
    dialog->selectFile(file.fileName());
    if (dialog.Run() != QDialog::Accepted || dialog->selectedFiles().isEmpty()) return;
    chosen = dialog->selectedFiles().first().toStdString();
  }
  if (!chosen) return;
  if (!EndsNoCase(*chosen, ".pdf")) *chosen += ".pdf";
  text2_->setText(QString::fromStdString(*chosen));
}

void PrintKora::Proceed() {
  Dialogs& dialogs = services_.dialogs;
  if (combo1_->currentIndex() < 0) return dialogs.Message(kNoPrinter, kPrinterPage);
  std::string file;
  if (IsPdf()) {
    file = FileOf(services_.files, text2_->text());
    if (file.size() < 5 || !EndsNoCase(file, ".pdf"))
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
  if (dark_->isChecked() != services_.settings.charts.DarkPaper) {
    services_.settings.charts.DarkPaper = dark_->isChecked();
    services_.ini.PutSetting("Charts", "DarkPaper", dark_->isChecked() ? "True" : "False");
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
