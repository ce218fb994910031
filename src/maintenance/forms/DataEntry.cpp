#include "maintenance/forms/DataEntry.h"

#include <QCheckBox>
#include <QGridLayout>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>

#include "base/dates.h"
#include "base/numbers.h"
#include "base/text.h"
#include "platform/qt/form_parts.h"
#include "settings/forms/Locate.h"

namespace kora {
namespace {

constexpr EntryBox kOrder[] = {EntryBox::kOpen, EntryBox::kHigh, EntryBox::kLow, EntryBox::kClose,
                               EntryBox::kVolume};
constexpr const char* kPrices[] = {"&Open", "&High", "&Low", "Clos&e", "&Volume"};
constexpr const char* kTotals[] = {"&Open", "R&ises", "&Falls", "C&um.Total", "&Volume"};
constexpr const char* kNames[] = {"Text2", "Text3", "Text4", "Text5", "Text6"};

}  // namespace

DataEntry::DataEntry(MaintenanceServices services, QWidget* parent)
    : WorkForm(std::move(services), parent), folder_(dataPath()) {
  setObjectName("DataEntry");
  setWindowTitle("Data Entry - Keyboard");
  auto* rows = new QVBoxLayout(this);

  auto* place = new QHBoxLayout;
  label18_ = new QLabel(this);
  label18_->setObjectName("Label18");
  label18_->setTextFormat(Qt::PlainText);
  label18_->setTextInteractionFlags(Qt::TextSelectableByMouse);
  auto* command4 = new QPushButton("Change &Directory", this);
  command4->setObjectName("Command4");
  command4->setAutoDefault(false);
  connect(command4, &QPushButton::clicked, this, [this] { ChooseFolder(); });
  place->addWidget(label18_, 1);
  place->addWidget(command4);
  rows->addLayout(place);

  auto* head = new QGridLayout;
  text1_ = NewField(this, "Text1", 10, 10);
  text7_ = NewField(this, "Text7", 8, 6);
  text7_->installEventFilter(this);
  text8_ = NewShown(this, "Text8", 34);
  text8_->setAccessibleName("Name");
  label17_ = new QLabel(this);
  label17_->setObjectName("Label17");
  head->addWidget(NewLabel(this, "Da&te  d/m/yy", text1_), 0, 0);
  head->addWidget(text1_, 0, 1);
  check2_ = new QCheckBox("Auto Date Adva&nce", this);
  check2_->setObjectName("Check2");
  check1_ = new QCheckBox("&Advance after Save", this);
  check1_->setObjectName("Check1");
  auto* ticks = new QHBoxLayout;
  ticks->addWidget(check2_);
  ticks->addWidget(check1_);
  ticks->addStretch();
  head->addLayout(ticks, 0, 2, 1, 2);
  head->addWidget(NewLabel(this, "&Code", text7_), 1, 0);
  head->addWidget(text7_, 1, 1);
  QWidget* arrows = NewStepper(this, "UpDown1", [this](int by) {
    if (security_) Open(security_->number + by);
  });
  head->addWidget(arrows, 1, 2);
  head->addWidget(text8_, 1, 3);
  head->addWidget(label17_, 2, 3);
  head->setColumnStretch(3, 1);
  rows->addLayout(head);

  auto* grid = new QGridLayout;
  const auto heading = [this](const char* text) {
    auto* label = new QLabel(text, this);
    QFont bold = label->font();
    bold.setBold(true);
    label->setFont(bold);
    return label;
  };
  previousDate_ = new QLabel(this);
  previousDate_->setObjectName("Label9");
  grid->addWidget(heading("Previous"), 0, 1, Qt::AlignRight);
  grid->addWidget(heading("Current"), 0, 2);
  grid->addWidget(previousDate_, 1, 1, Qt::AlignRight);
  for (size_t i = 0; i < kBoxes; ++i) {
    current_[i] = NewField(this, kNames[i], 12, 20);
    captions_[i] = NewLabel(this, kPrices[i], current_[i]);
    previous_[i] = new QLabel(this);
    previous_[i]->setObjectName(QString("Previous(%1)").arg(i));
    previous_[i]->setTextInteractionFlags(Qt::TextSelectableByMouse);
    previous_[i]->setMinimumWidth(fontMetrics().averageCharWidth() * 14);
    previous_[i]->setAlignment(Qt::AlignRight | Qt::AlignVCenter);
    const int row = int(i) + 2;
    grid->addWidget(captions_[i], row, 0);
    grid->addWidget(previous_[i], row, 1);
    grid->addWidget(current_[i], row, 2);
  }
  grid->setColumnStretch(3, 1);
  rows->addLayout(grid);
  rows->addStretch();

  auto* buttons = new ButtonRow(this);
  auto* command1 = buttons->Add("Command1", "&Save", [this] { Save(); });
  auto* command2 = buttons->Add("Command2", "&Reset", [this] { Reset(); });
  auto* command3 = buttons->Add("Command3", "Close", [this] { reject(); });
  command2->setAutoDefault(false);
  command3->setAutoDefault(false);
  // Leaving by the mouse must not look a half-typed code up.
  for (QPushButton* button : {command2, command3, command4}) button->setFocusPolicy(Qt::TabFocus);
  rows->addLayout(buttons);

  // Date, code, prices, save; the rest behind them.
  QWidget* last = text1_;
  const auto next = [&](QWidget* widget) {
    setTabOrder(last, widget);
    last = widget;
  };
  next(text7_);
  for (QLineEdit* box : current_) next(box);
  next(command1);
  next(command2);
  next(command3);
  for (auto* arrow : arrows->findChildren<QWidget*>()) next(arrow);
  next(check2_);
  next(check1_);
  next(command4);

  connect(text7_, &QLineEdit::editingFinished, this, [this] { LeaveCode(); });
  connect(check2_, &QCheckBox::toggled, this, [this] { ProposeDate(); });
  text1_->setFocus();
}

bool DataEntry::Fill() { return Open(1); }

bool DataEntry::Open(std::int32_t number) {
  auto found = OpenEntry(services_.files, folder_, number, services_.dialogs);
  if (!found) return false;
  Show(std::move(*found));
  return true;
}

void DataEntry::Show(EntrySecurity security) {
  security_ = std::move(security);
  label18_->setText(ToQt(folder_));
  text7_->setText(ToQt(FromAnsi(security_->code)));
  text8_->setText(ToQt(FromAnsi(Trim(security_->name.Name.trimmed()))));
  text8_->setCursorPosition(0);
  const std::int16_t type = security_->name.RecType;
  label17_->setText("Rec.Tp  " + QString::number(type));
  for (size_t i = 0; i < kBoxes; ++i) {
    captions_[i]->setText(type == kAdvanceDecline ? kTotals[i] : kPrices[i]);
    for (QWidget* part : {static_cast<QWidget*>(captions_[i]), static_cast<QWidget*>(previous_[i]),
                          static_cast<QWidget*>(current_[i])})
      part->setVisible(EntryShows(type, kOrder[i]));
  }
  ClearBoxes();
  ShowPrevious();
  ProposeDate();
}

void DataEntry::ShowPrevious() {
  QStringList figures;
  QString date;
  if (const auto& last = security_->previous) {
    const auto day = ParseFileDate(last->RecDate.raw());
    date = ToQt(day ? FormatUserDate(*day) : FromAnsi(last->RecDate.trimmed()));
    for (const float price :
         {float(last->Open), float(last->High), float(last->Low), float(last->Close)})
      figures << ToQt(Str(price));
    figures << ToQt(Str(std::int32_t(last->Volume)));
  }
  previousDate_->setText(date);
  for (size_t i = 0; i < kBoxes; ++i) previous_[i]->setText(figures.value(qsizetype(i)));
}

void DataEntry::ProposeDate() {
  if (!check2_->isChecked() || !security_ || !security_->previous) return;
  const std::string date = NextEntryDate(security_->previous->RecDate.raw());
  if (!date.empty()) text1_->setText(ToQt(date));
}

void DataEntry::ClearBoxes() {
  for (QLineEdit* box : current_) box->clear();
}

// Enter in the code opens its security and saves nothing.
bool DataEntry::eventFilter(QObject* object, QEvent* event) {
  if (object == text7_ && event->type() == QEvent::KeyPress) {
    const int key = static_cast<QKeyEvent*>(event)->key();
    if (key == Qt::Key_Return || key == Qt::Key_Enter) {
      text7_->setModified(true);
      LeaveCode();
      text7_->selectAll();
      return true;
    }
  }
  return QDialog::eventFilter(object, event);
}

void DataEntry::LeaveCode() {
  if (!text7_->isModified()) return;
  text7_->setModified(false);
  const std::string typed = ToAnsi(text7_->text().toStdString());
  if (auto found = FindEntry(services_.files, folder_, typed, services_.dialogs)) {
    Show(std::move(*found));
    return;
  }
  if (security_) text7_->setText(ToQt(FromAnsi(security_->code)));
  FocusField(text7_);
}

EntryTexts DataEntry::Texts() const {
  const auto text = [](const QLineEdit* box) { return box->text().toStdString(); };
  return {text(text1_),      text(current_[0]), text(current_[1]),
          text(current_[2]), text(current_[3]), text(current_[4])};
}

QLineEdit* DataEntry::BoxOf(EntryBox box) const {
  if (box == EntryBox::kDate) return text1_;
  for (size_t i = 0; i < kBoxes; ++i)
    if (kOrder[i] == box) return current_[i];
  return nullptr;
}

void DataEntry::Save() {
  // A code typed in front of a key for the button: its security is shown, and saved the next time.
  if (text7_->isModified()) {
    LeaveCode();
    return;
  }
  if (!security_) return;
  EntryBox focus;
  if (!SaveEntry(services_.files, *security_, Texts(), services_.dialogs, focus)) {
    if (QLineEdit* box = BoxOf(focus)) FocusField(box);
    return;
  }
  SetChanged();
  if (check1_->isChecked()) {
    Open(security_->number + 1);
  } else {
    ClearBoxes();
    ShowPrevious();
    ProposeDate();
  }
  FocusField(text7_);
}

void DataEntry::Reset() {
  ClearBoxes();
  text1_->clear();
  ProposeDate();
  if (security_) text7_->setText(ToQt(FromAnsi(security_->code)));
  FocusField(text1_);
}

void DataEntry::ChooseFolder() {
  std::string chosen;
  RunForm(new Locate(
      services_.files, services_.dialogs, {"Charting Data File Folder", folder_},
      [&](const std::string& folder) { chosen = folder; }, this));
  if (chosen.empty()) return;
  auto found = OpenEntry(services_.files, chosen, 1, services_.dialogs);
  if (!found) return;
  folder_ = chosen;
  Show(std::move(*found));
}

}  // namespace kora
