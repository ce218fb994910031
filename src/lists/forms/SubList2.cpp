#include "lists/forms/SubList2.h"

#include <QComboBox>
#include <QEvent>
#include <QGridLayout>
#include <QGroupBox>
#include <QLabel>
#include <QPushButton>

#include "base/runtime_error.h"
#include "base/text.h"
#include "store/name_file.h"
namespace kora {
namespace {

constexpr const char* kTitle = "Chart List Utilities";

}  // namespace

SubList2::SubList2(ListFormServices services, QWidget* parent)
    : QDialog(parent), services_(services) {
  setObjectName("SubList2");
  setWindowTitle(kTitle);
  try {
    for (const NameRec& rec : ReadNames(services_.files, services_.settings.paths.CurrentDataPath))
      names_.emplace(rec.Code.trimmed(), FromAnsi(rec.Name.trimmed()));
  } catch (const RunTimeError&) {
    // The codes alone do; what needs the name file tells of it.
  }
  auto* grid = new QGridLayout(this);

  const char* captions[] = {"&First list", "S&econd list"};
  for (int side = 0; side < 2; ++side) {
    combo1_[side] = new QComboBox(this);
    combo1_[side]->setObjectName(QString("Combo1(%1)").arg(side));
    for (std::int16_t number = kFirstChartList; number <= kResultList; ++number)
      combo1_[side]->addItem(QString::fromStdString(ChartListName(services_.user, number)));
    combo1_[side]->setCurrentIndex(-1);
    auto* caption = new QLabel(captions[side], this);
    caption->setBuddy(combo1_[side]);
    list1_[side] = new CodeList(side == 0 ? "List1(0)" : "List1(1)", this);
    list1_[side]->setAccessibleName(QString(captions[side]).remove('&'));
    AddEditOptions(
        list1_[side], "&Delete", [this, side] { DeleteSelected(side); },
        [this, side] { DeleteAll(side); });
    grid->addWidget(caption, 0, side * 2);
    grid->addWidget(combo1_[side], 1, side * 2);
    grid->addWidget(list1_[side], 2, side * 2);
    grid->setColumnStretch(side * 2, 1);
    connect(combo1_[side], &QComboBox::activated, this,
            [this, side](int index) { ListChosen(side, index); });
  }

  const auto button = [this](const char* name, const char* caption, const char* tip) {
    auto* made = new QPushButton(caption, this);
    made->setObjectName(name);
    made->setAutoDefault(false);
    made->setToolTip(tip);
    return made;
  };
  auto* middle = new QVBoxLayout;
  middle->addStretch();
  const auto group = [&](const char* title, const char* tip, int first, bool move) {
    auto* box = new QGroupBox(title, this);
    auto* rows = new QVBoxLayout(box);
    for (int to = 0; to < 2; ++to) {
      const std::string name = "Command1(" + std::to_string(first + to) + ")";
      auto* arrow = button(name.c_str(), to == 0 ? "<--- " : " --->", tip);
      arrow->setAccessibleName(QString(title) +
                               (to == 0 ? " to the first list" : " to the second list"));
      connect(arrow, &QPushButton::clicked, this, [this, to, move] { Transfer(1 - to, move); });
      rows->addWidget(arrow);
    }
    middle->addWidget(box);
  };
  group("Copy", "Copies an item to the other list", 0, false);
  group("Move", "Moves selected item/s to other list", 2, true);
  middle->addStretch();
  grid->addLayout(middle, 2, 1);
  grid->setRowStretch(2, 1);

  auto* check = button("Command2(1)", "Check &all lists", "Checks all codes with Name file list");
  save_ = button("Command2(2)", "&Save", "");
  auto* close = button("Command2(0)", "&Close", "");
  auto* buttons = new QHBoxLayout;
  state_ = new QLabel(this);
  state_->setObjectName("Label4");
  state_->setTextFormat(Qt::PlainText);
  buttons->addWidget(check);
  buttons->addWidget(state_);
  buttons->addStretch();
  buttons->addWidget(save_);
  buttons->addWidget(close);
  grid->addLayout(buttons, 3, 0, 1, 3);

  setTabOrder(combo1_[0], list1_[0]);
  setTabOrder(list1_[0], combo1_[1]);
  setTabOrder(combo1_[1], list1_[1]);
  connect(check, &QPushButton::clicked, this, [this] { CheckAll(); });
  connect(save_, &QPushButton::clicked, this, [this] {
    for (int side = 0; side < 2; ++side)
      if (sides_[side].Changed) SaveSL(side);
  });
  connect(close, &QPushButton::clicked, this, &QDialog::reject);
  Edited();
}

std::string SubList2::NameOf(int side) const {
  return combo1_[side]->itemText(sides_[side].ChartListNo - kFirstChartList).toStdString();
}

void SubList2::Edited() { save_->setEnabled(sides_[0].Changed || sides_[1].Changed); }

void SubList2::ListChosen(int side, int index) {
  ListSide chosen;
  chosen.ChartListNo = std::int16_t(index + kFirstChartList);
  if (chosen.ChartListNo == sides_[side].ChartListNo) return;
  if (!LeaveList(side)) {
    combo1_[side]->setCurrentIndex(sides_[side].ChartListNo - kFirstChartList);
    return;
  }
  // The same list twice would be saved twice, each time without the other's changes: this side
  // stays without a list.
  const ListSide& other = sides_[1 - side];
  if (other.ChartListNo == chosen.ChartListNo) {
    services_.dialogs.Message(CheckSides(chosen, other), kTitle);
    chosen.ChartListNo = 0;
  }
  sides_[side] = chosen;
  ShowSide(side);
}

// Reads the list anew.
void SubList2::ShowSide(int side) {
  ListSide& shown = sides_[side];
  shown.Codes.clear();
  shown.Changed = false;
  if (shown.ChartListNo != 0)
    TellErrors(services_.dialogs, kTitle, [&] {
      stamps_[side] = services_.files.Stamp(
          ListFilePath(services_.settings.paths.CurrentDataPath, shown.ChartListNo));
      shown.Codes = CodesOf(
          ReadList(services_.files, services_.settings.paths.CurrentDataPath, shown.ChartListNo));
    });
  list1_[side]->Show(shown.Codes, names_);
  Edited();
}

void SubList2::Transfer(int from, bool move) {
  ListSide &source = sides_[from], &target = sides_[1 - from];
  const auto places = list1_[from]->Selected();
  const std::string_view fault =
      move ? MoveItems(source, target, places) : CopyItems(source, target, places);
  if (!fault.empty()) {
    services_.dialogs.Message(fault, kTitle);
    return;
  }
  if (places.empty()) return;
  if (move) list1_[from]->Show(source.Codes, names_);
  list1_[1 - from]->Show(target.Codes, names_);
  Edited();
}

void SubList2::DeleteSelected(int side) {
  std::vector<size_t> gone;
  ListSide& shown = sides_[side];
  for (const size_t place : list1_[side]->Selected())
    if (services_.dialogs.Ask(DeleteQuestion(shown.Codes[place]), kTitle, Buttons::kYesNo) ==
        Answer::kYes)
      gone.push_back(place);
  if (gone.empty()) return;
  DeleteItems(shown.Codes, gone);
  shown.Changed = true;
  list1_[side]->Show(shown.Codes, names_);
  Edited();
}

void SubList2::DeleteAll(int side) {
  ListSide& shown = sides_[side];
  if (shown.Codes.empty() || services_.dialogs.Ask(DeleteAllFromQuestion(NameOf(side)), kTitle,
                                                   Buttons::kYesNo) != Answer::kYes)
    return;
  shown.Codes.clear();
  shown.Changed = true;
  list1_[side]->clear();
  Edited();
}

void SubList2::CheckAll() {
  if (!LeaveList(0) || !LeaveList(1)) return;
  services_.dialogs.SetBusy(true);
  state_->setText("Checking SubLists");
  state_->repaint();
  const bool checked = TellErrors(services_.dialogs, kTitle, [this] {
    CheckAllLists(services_.files, services_.settings.paths.CurrentDataPath);
  });
  state_->setText(checked ? "COMPLETED" : "");
  services_.dialogs.SetBusy(false);
  ShowSide(0);
  ShowSide(1);
}

bool SubList2::SaveSL(int side) {
  ListSide& shown = sides_[side];
  const std::string& dataPath = services_.settings.paths.CurrentDataPath;
  bool save = true;
  if (!TellErrors(services_.dialogs, kTitle,
                  [&] {
                    const auto held = services_.files.lock().Hold();
                    const auto stamp =
                        services_.files.Stamp(ListFilePath(dataPath, shown.ChartListNo));
                    save = stamp == stamps_[side] ||
                           services_.dialogs.Ask(kListChangedOutside, kTitle, Buttons::kYesNo) ==
                               Answer::kYes;
                    if (save)
                      SaveSubList(services_.files, dataPath, shown.ChartListNo, shown.Codes);
                  }) ||
      !save)
    return false;
  ShowSide(side);
  return true;
}

bool SubList2::LeaveList(int side) {
  if (!sides_[side].Changed) return true;
  if (services_.dialogs.Ask(ChangedQuestion(NameOf(side)), kTitle, Buttons::kYesNo) == Answer::kYes)
    return SaveSL(side);
  sides_[side].Changed = false;
  return true;
}

// Coming back to the form, a list that another program changed is read again.
bool SubList2::event(QEvent* event) {
  if (event->type() == QEvent::WindowActivate)
    for (const int side : {0, 1})
      if (const ListSide& shown = sides_[side]; shown.ChartListNo != 0 && !shown.Changed)
        TellErrors(services_.dialogs, kTitle, [&] {
          const std::string& dataPath = services_.settings.paths.CurrentDataPath;
          if (services_.files.Stamp(ListFilePath(dataPath, shown.ChartListNo)) != stamps_[side])
            ShowSide(side);
        });
  return QDialog::event(event);
}

void SubList2::reject() {
  if (LeaveList(0) && LeaveList(1)) QDialog::reject();
}

}  // namespace kora
