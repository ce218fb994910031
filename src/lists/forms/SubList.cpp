#include "lists/forms/SubList.h"

#include <QComboBox>
#include <QGridLayout>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QSpinBox>

#include "base/text.h"
#include "store/name_file.h"

namespace kora {
namespace {

constexpr const char* kTitle = "Chart Lists";

QLabel* Caption(const char* text, QWidget* buddy, QWidget* parent) {
  auto* label = new QLabel(text, parent);
  label->setBuddy(buddy);
  return label;
}

QPushButton* Button(const char* name, const char* caption, QWidget* parent) {
  auto* button = new QPushButton(caption, parent);
  button->setObjectName(name);
  button->setAutoDefault(false);
  return button;
}

}  // namespace

SubList::SubList(ListFormServices services, QWidget* parent)
    : QDialog(parent), services_(std::move(services)) {
  setObjectName("SubList");
  setWindowTitle(kTitle);

  combo1_ = new QComboBox(this);
  combo1_->setObjectName("Combo1");
  list1_ = new CodeList("List1", this);
  list1_->setAccessibleName("Current Chart List");
  AddEditOptions(
      list1_, "&Delete Selected Item/s", [this] { DeleteSelected(); }, [this] { DeleteAll(); });
  text2_ = new QLineEdit(this);
  text2_->setObjectName("Text2");
  text2_->setMaxLength(6);
  text2_->installEventFilter(this);
  add_ = Button("Command4", "< &Add", this);
  del_ = Button("Command1", "&Del", this);
  select_ = Button("Command5", "Code S&election", this);
  select_->setVisible(bool(services_.openCodes));
  list2_ = new CodeList("List2", this);
  list2_->setAccessibleName("Current name file codes");
  list2_->installEventFilter(this);
  auto* columns = new QSpinBox(this);
  columns->setObjectName("Text1");
  columns->setRange(1, 9);
  list2_->SetColumns(1);  // with room for the names
  save_ = Button("Command2", "&Save", this);
  auto* close = Button("Command3", "C&lose", this);

  auto* grid = new QGridLayout(this);
  grid->addWidget(Caption("Select a &chart list", combo1_, this), 0, 0);
  grid->addWidget(combo1_, 1, 0);
  grid->addWidget(Caption("C&urrent Chart List", list1_, this), 2, 0);
  grid->addWidget(list1_, 3, 0);

  auto* middle = new QVBoxLayout;
  middle->addStretch();
  middle->addWidget(add_);
  middle->addWidget(del_);
  middle->addStretch();
  grid->addLayout(middle, 3, 1);

  grid->addWidget(Caption("&Type a code and press ENTER", text2_, this), 0, 2, 1, 3);
  grid->addWidget(text2_, 1, 2);
  grid->addWidget(select_, 1, 3, 1, 2);
  grid->addWidget(Caption("Current &name file codes", list2_, this), 2, 2);
  grid->addWidget(Caption("C&olumns", columns, this), 2, 3, Qt::AlignRight);
  grid->addWidget(columns, 2, 4);
  grid->addWidget(list2_, 3, 2, 1, 3);
  grid->setColumnStretch(0, 2);
  grid->setColumnStretch(2, 3);
  grid->setRowStretch(3, 1);

  auto* buttons = new QHBoxLayout;
  buttons->addStretch();
  buttons->addWidget(save_);
  buttons->addWidget(close);
  grid->addLayout(buttons, 4, 0, 1, 5);

  setTabOrder(combo1_, text2_);
  setTabOrder(text2_, select_);
  setTabOrder(select_, list2_);
  setTabOrder(list2_, columns);
  setTabOrder(columns, add_);
  setTabOrder(add_, list1_);
  setTabOrder(list1_, del_);
  setTabOrder(del_, save_);
  setTabOrder(save_, close);

  ComboList();
  StockList();
  Edited();
  connect(text2_, &QLineEdit::textEdited, this, &SubList::FindWhileTyping);
  connect(combo1_, &QComboBox::activated, this, [this](int index) { ListChosen(index); });
  connect(add_, &QPushButton::clicked, this, [this] { Add(); });
  connect(del_, &QPushButton::clicked, this, [this] { DeleteSelected(); });
  connect(select_, &QPushButton::clicked, this, [this] { OpenCodes(); });
  connect(list2_, &QListWidget::itemDoubleClicked, this, [this] { Add(); });
  connect(list1_, &QListWidget::itemSelectionChanged, this, [this] { Edited(); });
  connect(list2_, &QListWidget::itemSelectionChanged, this, [this] { Edited(); });
  connect(columns, &QSpinBox::valueChanged, this, [this](int n) { list2_->SetColumns(n); });
  connect(save_, &QPushButton::clicked, this, [this] { Save(); });
  connect(close, &QPushButton::clicked, this, &QDialog::reject);
}

void SubList::ComboList() {
  for (std::int16_t number = kFirstChartList; number <= kResultList; ++number)
    combo1_->addItem(QString::fromStdString(ChartListName(services_.user, number)));
  combo1_->setCurrentIndex(-1);
}

void SubList::ShowList() {
  codes_.clear();
  changed_ = false;
  const std::string& dataPath = services_.settings.paths.CurrentDataPath;
  TellErrors(services_.dialogs, kTitle, [&] {
    listStamp_ = services_.files.Stamp(ListFilePath(dataPath, ListNo()));
    codes_ = CodesOf(ReadList(services_.files, dataPath, ListNo()));
  });
  list1_->Show(codes_, names_);
  Edited();
}

void SubList::StockList() {
  const std::string& dataPath = services_.settings.paths.CurrentDataPath;
  nameCodes_.clear();
  names_.clear();
  TellErrors(services_.dialogs, kTitle, [&] {
    namesStamp_ = services_.files.Stamp(NameFilePath(dataPath));
    for (const NameRec& rec : ReadNames(services_.files, dataPath)) {
      if (rec.Code.trimmed().empty()) continue;
      nameCodes_.emplace_back(rec.Code.trimmed());
      names_.emplace(nameCodes_.back(), FromAnsi(rec.Name.trimmed()));
    }
  });
  list2_->Show(nameCodes_, names_);
}

// The first code that begins with what is typed, else the first name with it.
void SubList::FindWhileTyping(const QString& typed) {
  const std::string wanted = UCase(Trim(typed.toStdString()));
  if (wanted.empty()) return;
  for (const bool byName : {false, true}) {
    for (size_t i = 0; i < nameCodes_.size(); ++i) {
      const bool matches = byName ? UCase(names_[nameCodes_[i]]).find(wanted) != std::string::npos
                                  : UCase(nameCodes_[i]).starts_with(wanted);
      if (matches) return list2_->SelectOnly(i);
    }
  }
}

void SubList::LookAgain() {
  const std::string& dataPath = services_.settings.paths.CurrentDataPath;
  TellErrors(services_.dialogs, kTitle, [&] {
    if (services_.files.Stamp(NameFilePath(dataPath)) != namesStamp_) StockList();
    if (list_ >= 0 && !changed_ &&
        services_.files.Stamp(ListFilePath(dataPath, ListNo())) != listStamp_)
      ShowList();
  });
}

// What can be done now.
void SubList::Edited() {
  const bool open = list_ >= 0;
  text2_->setEnabled(open);
  select_->setEnabled(open);
  add_->setEnabled(open && !list2_->selectedItems().isEmpty());
  del_->setEnabled(open && !list1_->selectedItems().isEmpty());
  save_->setEnabled(changed_);
}

void SubList::ListChosen(int index) {
  if (index == list_) return;
  if (!LeaveList()) {
    combo1_->setCurrentIndex(list_);
    return;
  }
  list_ = index;
  ShowList();
}

void SubList::AddAt(size_t place) {
  if (!AddCode(codes_, nameCodes_[place])) return;
  changed_ = true;
  list1_->Append(codes_.back(), names_);
  list1_->SelectOnly(codes_.size() - 1);
}

void SubList::Add() {
  if (list_ < 0) return;
  for (const size_t place : list2_->Selected()) AddAt(place);
  Edited();
}

void SubList::AddTyped() {
  const auto place = FindTypedCode(nameCodes_, text2_->text().toStdString());
  if (!place) {
    services_.dialogs.Message(kCodeNotFound, kTitle);
    text2_->selectAll();
    return;
  }
  list2_->SelectOnly(*place);
  AddAt(*place);
  text2_->clear();
  Edited();
}

void SubList::OpenCodes() {
  const auto select = [this](const std::string& code) {
    const auto place = FindTypedCode(nameCodes_, code);
    if (!place) {
      services_.dialogs.Message(kCodeNotFound, kTitle);
      return;
    }
    AddAt(*place);
    Edited();
  };
  TellErrors(services_.dialogs, kTitle, [&] { services_.openCodes(this, select); });
}

void SubList::DeleteSelected() {
  std::vector<size_t> gone;
  for (const size_t place : list1_->Selected())
    if (services_.dialogs.Ask(DeleteQuestion(codes_[place]), kTitle, Buttons::kYesNo) ==
        Answer::kYes)
      gone.push_back(place);
  if (gone.empty()) return;
  DeleteItems(codes_, gone);
  changed_ = true;
  list1_->Show(codes_, names_);
  if (!codes_.empty()) list1_->SelectOnly(std::min(gone.front(), codes_.size() - 1));
  Edited();
}

void SubList::DeleteAll() {
  if (codes_.empty() ||
      services_.dialogs.Ask(kDeleteAllItems, kTitle, Buttons::kYesNo) != Answer::kYes)
    return;
  codes_.clear();
  changed_ = true;
  list1_->clear();
  Edited();
}

bool SubList::Save() {
  const std::string& dataPath = services_.settings.paths.CurrentDataPath;
  bool save = true;
  if (!TellErrors(services_.dialogs, kTitle,
                  [&] {
                    const auto held = services_.files.lock().Hold();
                    save = services_.files.Stamp(ListFilePath(dataPath, ListNo())) == listStamp_ ||
                           services_.dialogs.Ask(kListChangedOutside, kTitle, Buttons::kYesNo) ==
                               Answer::kYes;
                    if (save) SaveSubList(services_.files, dataPath, ListNo(), codes_);
                  }) ||
      !save)
    return false;
  ShowList();
  return true;
}

bool SubList::LeaveList() {
  if (!changed_) return true;
  const std::string name = combo1_->itemText(list_).toStdString();
  if (services_.dialogs.Ask(ChangedQuestion(name), kTitle, Buttons::kYesNo) == Answer::kYes)
    return Save();
  changed_ = false;
  return true;
}

void SubList::reject() {
  if (LeaveList()) QDialog::reject();
}

bool SubList::event(QEvent* event) {
  if (event->type() == QEvent::WindowActivate) LookAgain();
  return QDialog::event(event);
}

bool SubList::eventFilter(QObject* object, QEvent* event) {
  if (event->type() == QEvent::KeyPress) {
    const int key = static_cast<QKeyEvent*>(event)->key();
    if (key == Qt::Key_Return || key == Qt::Key_Enter) {
      if (object == text2_)
        AddTyped();
      else
        Add();
      return true;
    }
  }
  return QDialog::eventFilter(object, event);
}

}  // namespace kora
