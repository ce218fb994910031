#include "maintenance/forms/TextData.h"

#include <QButtonGroup>
#include <QCheckBox>
#include <QLabel>
#include <QLineEdit>
#include <QPointer>
#include <QPushButton>
#include <QRadioButton>

#include "platform/qt/form_parts.h"

namespace kora {

ExportFormBoxes::ExportFormBoxes(QDialog* form, QBoxLayout* rows, const char* commas,
                                 const char* columns) {
  check1 = new QCheckBox(commas, form);
  check1->setObjectName("Check1");
  check2 = new QCheckBox(columns, form);
  check2->setObjectName("Check2");
  auto* group = new QButtonGroup(form);
  for (QCheckBox* check : {check1, check2}) {
    group->addButton(check);
    rows->addWidget(check);
  }
  check1->setChecked(true);
}

ExportForm ExportFormBoxes::form() const {
  return check2->isChecked() ? ExportForm::kColumns : ExportForm::kCommas;
}

TextData::TextData(MaintenanceServices services, QWidget* parent)
    : WorkForm(std::move(services), parent) {
  setObjectName("TextData");
  setWindowTitle("Create Text File of Closing Prices");
  auto* rows = new QVBoxLayout(this);
  for (const char* text :
       {"This procedure creates a Text file of closing prices for each stock.",
        "The text file created will be DATE.TXT eg 20NOV96.TXT and will be located in "
        "\\KORAWIN\\CHTMISC directory."})
    rows->addWidget(NewNote(this, text, 60));
  option1_ = new QRadioButton("&Latest Date", this);
  option1_->setObjectName("Option1");
  option1_->setChecked(true);
  option2_ = new QRadioButton("&Particular date", this);
  option2_->setObjectName("Option2");
  auto* dates = new QButtonGroup(this);
  dates->addButton(option1_);
  dates->addButton(option2_);
  text1_ = NewField(this, "Text1", 10, 10);
  text1_->setEnabled(false);
  rows->addWidget(option1_);
  auto* line = new QHBoxLayout;
  line->addWidget(option2_);
  line->addWidget(text1_);
  line->addWidget(NewLabel(this, "d/m/&yy", text1_));
  line->addStretch();
  rows->addLayout(line);
  rows->addWidget(NewLabel(this, "Format"));
  boxes_.emplace(this, rows, "C&ode,Date,Close", "Code        &Date        Close");
  rows->addStretch();
  AddPanel(rows);
  auto* buttons = new ButtonRow(this);
  auto* command1 = buttons->Add("Command1", "Create &Text File", [this] { Create(); });
  buttons->Add("Command2", "&Close", [this] { reject(); })->setAutoDefault(false);
  rows->addLayout(buttons);
  panel_->Hold({option1_, option2_, text1_, boxes_->check1, boxes_->check2, command1});
  connect(option2_, &QRadioButton::toggled, this, [this](bool on) {
    text1_->setEnabled(on);
    if (on) text1_->setFocus();
  });
}

void TextData::Create() {
  if (panel_->running()) return;
  const QPointer<TextData> here = this;
  std::optional<std::string> date;
  if (option2_->isChecked()) date = text1_->text().toStdString();
  bool made = false;
  Run([&](Progress& progress) {
    made = ExportCloses(services_.files, dataPath(), services_.settings.paths.ChartMiscPath, date,
                        boxes_->form(), progress, services_.dialogs)
               .has_value();
  });
  if (here && !made && date) FocusField(text1_);
}

}  // namespace kora
