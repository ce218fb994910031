#include "maintenance/forms/RemDate.h"

#include <QGridLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPointer>
#include <QPushButton>
#include <QRadioButton>
#include <QToolButton>

#include "maintenance/remove_date.h"
#include "platform/qt/form_parts.h"
#include "settings/forms/Locate.h"

namespace kora {

RemDate::RemDate(MaintenanceServices services, QWidget* parent)
    : WorkForm(std::move(services), parent) {
  setObjectName("RemDate");
  setWindowTitle("Remove Specific Date");
  auto* rows = new QVBoxLayout(this);
  rows->addWidget(NewNote(this,
                          "Removes data for a date, as specified, from all the charting data files "
                          "in the directory indicated",
                          60));
  auto* grid = new QGridLayout;
  text1_ = NewField(this, "Text1", 40, 250);
  text1_->setText(ToQt(dataPath()));
  auto* choose = NewFolderButton(this, "Picture1", [this] { ChooseFolder(); });
  text2_ = NewField(this, "Text2", 10, 10);
  grid->addWidget(NewLabel(this, "Charting Data &File Path  eg.  c:\\korawin\\data\\   ", text1_),
                  0, 0, 1, 2);
  grid->addWidget(text1_, 1, 0);
  grid->addWidget(choose, 1, 1);
  grid->addWidget(NewLabel(this, "D&ate to remove (d/m/yy)  eg. 1/12/97", text2_), 2, 0, 1, 2);
  grid->addWidget(text2_, 3, 0, 1, 2);
  grid->setColumnStretch(0, 1);
  rows->addLayout(grid);
  static constexpr const char* kCaptions[] = {"Remove ALL &instances of that date",
                                              "Remove only the &LATEST instance of that date"};
  for (int i = 0; i < 2; ++i) {
    option1_[i] = new QRadioButton(kCaptions[i], this);
    option1_[i]->setObjectName(QString("Option1(%1)").arg(i));
    rows->addWidget(option1_[i]);
  }
  option1_[0]->setChecked(true);
  AddState(rows, "Label4");
  rows->addStretch();
  AddPanel(rows);
  auto* buttons = new ButtonRow(this);
  auto* command1 = buttons->Add("Command1", "&Remove Date", [this] { Remove(); });
  command2_ = buttons->Add("Command2", "&Close", [this] { reject(); });
  command2_->setAutoDefault(false);
  rows->addLayout(buttons);
  panel_->Hold({text1_, choose, text2_, option1_[0], option1_[1], command1});
  text2_->setFocus();
}

void RemDate::Remove() {
  if (panel_->running()) return;
  const QPointer<RemDate> here = this;
  const std::string before = dataPath();
  RemoveDateBox focus = RemoveDateBox::kNone;
  RemovedDate removed;
  state_->clear();
  Run([&](Progress& progress) {
    removed = RemoveDate(services_.files, services_.settings, text1_->text().toStdString(),
                         text2_->text().toStdString(), option1_[0]->isChecked() == false, progress,
                         services_.dialogs, focus);
  });
  if (!here) return;
  if (dataPath() != before && services_.folderChanged) services_.folderChanged();
  if (removed.files > 0) SetChanged();
  switch (focus) {
    case RemoveDateBox::kFolder: FocusField(text1_); break;
    case RemoveDateBox::kDate: FocusField(text2_); break;
    case RemoveDateBox::kNone: command2_->setFocus(); break;
  }
}

void RemDate::ChooseFolder() {
  RunForm(new Locate(
      services_.files, services_.dialogs,
      {"Charting Data File Folder", text1_->text().toStdString()},
      [this](const std::string& folder) { text1_->setText(ToQt(folder)); }, this));
}

}  // namespace kora
