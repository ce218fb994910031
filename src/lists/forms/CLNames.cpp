#include "lists/forms/CLNames.h"

#include <QGridLayout>
#include <QLabel>
#include <QLineEdit>

#include "platform/qt/form_parts.h"

namespace kora {

CLNames::CLNames(ListFormServices services, QWidget* parent)
    : QDialog(parent), services_(services) {
  setObjectName("CLNames");
  setWindowTitle("Rename Chart Lists");
  auto* grid = new QGridLayout(this);
  const UserListNames names = GetSubLists(services_.user);
  constexpr const char* kCaptions[kUserLists] = {"List &A", "List &B", "List &C", "List &D",
                                                 "List &E", "List &F", "List &G", "List &H",
                                                 "List &J", "List &K"};
  for (int i = 0; i < kUserLists; ++i) {
    auto* label = new QLabel(kCaptions[i], this);
    text1_[i] = new QLineEdit(QString::fromStdString(names[size_t(i)]), this);
    text1_[i]->setObjectName(QString("Text1(%1)").arg(i));
    text1_[i]->setMaxLength(40);
    text1_[i]->setMinimumWidth(fontMetrics().averageCharWidth() * 36);
    label->setBuddy(text1_[i]);
    grid->addWidget(label, i, 0);
    grid->addWidget(text1_[i], i, 1);
    connect(text1_[i], &QLineEdit::textEdited, this, [this] { changed_ = true; });
  }
  grid->setColumnStretch(1, 1);
  auto* buttons = new ButtonRow(this);
  buttons->Add("Command1", "&Save", [this] {
    if (Save()) accept();
  });
  buttons->Add("Command2", "C&lose", [this] { reject(); });
  grid->addLayout(buttons, kUserLists, 0, 1, 2);
  grid->setRowStretch(kUserLists, 1);
}

bool CLNames::Save() {
  UserListNames names;
  for (int i = 0; i < kUserLists; ++i) {
    std::string& name = names[size_t(i)];
    name = text1_[i]->text().trimmed().toStdString();
    if (const std::string why = WhyNotKept(name); !why.empty()) {
      services_.dialogs.Message(name + " " + why, "Sub-List Names");
      text1_[i]->setFocus();
      return false;
    }
  }
  if (!SaveSLNames(services_.user, names)) {
    services_.dialogs.Message("Unable to save data", "Sub-List Names");
    return false;
  }
  changed_ = false;
  return true;
}

void CLNames::reject() {
  if (changed_ &&
      services_.dialogs.Ask(kSaveChanges, "Sub-List Names", Buttons::kYesNo) == Answer::kYes &&
      !Save())
    return;
  QDialog::reject();
}

}  // namespace kora
