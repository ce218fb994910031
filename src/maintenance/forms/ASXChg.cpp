#include "maintenance/forms/ASXChg.h"

#include <QGridLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPointer>
#include <QPushButton>

#include "maintenance/code_change.h"
#include "platform/qt/form_parts.h"

namespace kora {

ASXChg::ASXChg(MaintenanceServices services, QWidget* parent)
    : WorkForm(std::move(services), parent) {
  setObjectName("ASXChg");
  setWindowTitle("Code Changed - Combine Files");
  auto* rows = new QVBoxLayout(this);
  for (const char* text :
       {"Occasionally an ASX code of a company may change.", "This procedure will:-",
        "1) rename your data files and Name file entry",
        "2) combine data if you have ended up with a data file for both codes.",
        "IMPORTANT: This routine does not rename the code in the download Mainfile - you will have "
        "to do that manually."})
    rows->addWidget(NewNote(this, text, 60));
  auto* grid = new QGridLayout;
  text1_ = NewField(this, "Text1", 8, 6);
  text2_ = NewField(this, "Text2", 8, 6);
  grid->addWidget(NewLabel(this, "&Old ASX Code", text1_), 0, 0);
  grid->addWidget(text1_, 0, 1);
  grid->addWidget(NewLabel(this, "&New ASX Code", text2_), 1, 0);
  grid->addWidget(text2_, 1, 1);
  grid->setColumnStretch(2, 1);
  rows->addLayout(grid);
  AddState(rows, "Label4");
  rows->addStretch();
  auto* buttons = new ButtonRow(this);
  buttons->Add("Command2", "C&HANGE/COMBINE", [this] { Change(); });
  buttons->Add("Command1", "&Close", [this] { reject(); })->setAutoDefault(false);
  rows->addLayout(buttons);
  text1_->setFocus();
}

void ASXChg::Change() {
  const QPointer<ASXChg> here = this;
  CodeBox focus = CodeBox::kNone;
  CodeChange end = CodeChange::kRefused;
  Run([&](Progress& progress) {
    end = ChangeCode(services_.files, dataPath(), text1_->text().toStdString(),
                     text2_->text().toStdString(), progress, services_.dialogs, focus);
  });
  if (!here) return;
  if (end == CodeChange::kChanged) SetChanged();
  FocusField(focus == CodeBox::kNew ? text2_ : text1_);
}

}  // namespace kora
