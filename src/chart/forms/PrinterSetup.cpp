#include "chart/forms/PrinterSetup.h"

#include <QComboBox>
#include <QGridLayout>
#include <QLabel>
#include <QRadioButton>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "chart/forms/printer_list.h"
#include "platform/qt/form_parts.h"

namespace kora {

PrinterSetup::PrinterSetup(const PrintServices& services, QWidget* parent)
    : QDialog(parent), services_(services) {
  setObjectName("PrinterSetup");
  setWindowTitle("Printer Setup");
  const Printer& printer = services_.printer;
  combo1_ = NewPrinterList(this, printer);
  combo2_ = new QComboBox(this);
  combo2_->setObjectName("Combo2");
  for (const std::string& name : printer.PaperNames()) combo2_->addItem(ToQt(name));
  combo2_->setCurrentIndex(combo2_->findText(ToQt(printer.PaperName())));
  auto* portrait = new QRadioButton("Por&trait", this);
  portrait->setObjectName("Option1(0)");
  landscape_ = new QRadioButton("&Landscape", this);
  landscape_->setObjectName("Option1(1)");
  (printer.Orientation() == kLandscape ? landscape_ : portrait)->setChecked(true);

  auto* grid = new QGridLayout(this);
  grid->addWidget(NewLabel(this, "P&rinter", combo1_), 0, 0);
  grid->addWidget(combo1_, 0, 1);
  grid->addWidget(NewLabel(this, "P&aper", combo2_), 1, 0);
  grid->addWidget(combo2_, 1, 1);
  grid->addWidget(portrait, 2, 1);
  grid->addWidget(landscape_, 3, 1);
  grid->setColumnStretch(1, 1);
  grid->setRowStretch(4, 1);
  auto* buttons = new ButtonRow(this);
  buttons->Add("Command1", "&OK", [this] { Save(); });
  buttons->Add("Command2", "&Cancel", [this] { reject(); });
  grid->addLayout(buttons, 5, 0, 1, 2);
  combo1_->setFocus();
}

void PrinterSetup::Save() {
  if (combo1_->currentIndex() < 0) return services_.dialogs.Message(kNoPrinter, kPrinterPage);
  Printer& printer = services_.printer;
  try {
    printer.SetDevice(combo1_->currentText().toStdString());
    if (combo2_->currentText() != ToQt(printer.PaperName()))
      printer.SetPaper(combo2_->currentText().toStdString());
    printer.SetOrientation(landscape_->isChecked() ? kLandscape : kPortrait);
  } catch (const RunTimeError& e) {
    return services_.dialogs.Message(std::string("There is an unexpected error - ") + e.what(),
                                     "Error");
  }
  services_.settings.page.Orient = printer.Orientation();
  services_.ini.PutSetting("ChtPage", "Orient", Str(std::int32_t(printer.Orientation())));
  accept();
}

}  // namespace kora
