#include "indicators/forms/MultiOsc.h"

#include <QGridLayout>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>

#include "platform/qt/form_parts.h"

namespace kora {
namespace {

constexpr const char* kTitle = "Multi-Oscillator Display Selections";

}  // namespace

MultiOsc::MultiOsc(MultiOscServices services, QWidget* parent)
    : QDialog(parent), services_(services) {
  setObjectName("MultiOsc");
  setWindowTitle(kTitle);
  list1_ = new QListWidget(this);
  list1_->setObjectName("List1");
  list1_->setAccessibleName("Oscillators");
  for (const MultiOscName& name : MultiOscNames()) list1_->addItem(ToQt(name.name));
  list1_->setCurrentRow(0);
  list1_->setMinimumWidth(list1_->sizeHintForColumn(0) + 3 * fontMetrics().height());
  list1_->setMinimumHeight(int(MultiOscNames().size()) * list1_->sizeHintForRow(0) +
                           2 * list1_->frameWidth());
  list1_->installEventFilter(this);
  connect(list1_, &QListWidget::itemClicked, this, [this] { Put(); });

  auto* grid = new QGridLayout(this);
  const int gap = fontMetrics().height();
  grid->addWidget(NewLabel(this, "&Oscillators", list1_), 0, 0);
  grid->addWidget(list1_, 1, 0, kMultiOscSlots + 2, 1);
  grid->setColumnMinimumWidth(1, gap);
  for (int set = 1; set <= kMultiOscSets; ++set) AddColumn(grid, set);
  auto* note = NewNote(this,
                       "Choose a box, then an oscillator in the list. The panels stand below the "
                       "prices in this order; boxes with None are left out.");
  grid->addWidget(note, int(kMultiOscSlots) + 1, 2, 1, kMultiOscSets);
  grid->setRowStretch(int(kMultiOscSlots) + 2, 1);
  auto* buttons = new ButtonRow(this);
  buttons->Add("Command1", "&Close", [this] { reject(); });
  grid->addLayout(buttons, int(kMultiOscSlots) + 3, 0, 1, 2 + kMultiOscSets);
  Select(columns_[0].boxes[0]);
  selected_->setFocus();
}

void MultiOsc::AddColumn(QGridLayout* grid, int set) {
  Column& column = columns_[size_t(set - 1)];
  column.kept = ReadMOSet(services_.user, set);
  const QString title = QString("Multi-Oscillator &%1").arg(set);
  for (size_t slot = 0; slot < kMultiOscSlots; ++slot) {
    QLineEdit* box = NewField(this, QString("Text%1(%2)").arg(set).arg(slot), 20, 60);
    box->setText(ToQt(column.kept[slot]));
    box->setReadOnly(true);
    box->setAccessibleName(QString("Multi-Oscillator %1, panel %2").arg(set).arg(slot + 1));
    box->installEventFilter(this);
    grid->addWidget(box, int(slot) + 1, 1 + set);
    column.boxes[slot] = box;
  }
  grid->addWidget(NewLabel(this, title, column.boxes[0]), 0, 1 + set);
}

// The selected box stands out while the list has the keyboard, too.
void MultiOsc::Select(QLineEdit* box) {
  for (const Column& column : columns_)
    for (QLineEdit* each : column.boxes) {
      QPalette palette;
      if (each == box) {
        palette.setColor(QPalette::Base, palette.color(QPalette::Highlight));
        palette.setColor(QPalette::Text, palette.color(QPalette::HighlightedText));
      }
      each->setPalette(palette);
    }
  selected_ = box;
  box->selectAll();
  const auto names = list1_->findItems(box->text(), Qt::MatchExactly);
  if (!names.isEmpty()) list1_->setCurrentItem(names[0]);
}

// The name of the list goes into the selected box.
void MultiOsc::Put() {
  if (!list1_->currentItem()) return;
  selected_->setText(list1_->currentItem()->text());
  selected_->selectAll();
}

bool MultiOsc::eventFilter(QObject* object, QEvent* event) {
  auto* box = qobject_cast<QLineEdit*>(object);
  if (box && event->type() == QEvent::FocusIn) Select(box);
  if (event->type() == QEvent::KeyPress) {
    const int key = static_cast<QKeyEvent*>(event)->key();
    const bool chooses = key == Qt::Key_Return || key == Qt::Key_Enter || key == Qt::Key_Space;
    if (box && (key == Qt::Key_Delete || key == Qt::Key_Backspace)) {
      box->setText(ToQt(kNoOscillator));
      Select(box);
      return true;
    }
    // From a box to the list, and back with the name.
    if (box && chooses) {
      list1_->setFocus();
      return true;
    }
    if (object == list1_ && chooses) {
      Put();
      selected_->setFocus();
      return true;
    }
  }
  return QDialog::eventFilter(object, event);
}

bool MultiOsc::SaveMOSets() {
  for (int set = 1; set <= kMultiOscSets; ++set) {
    Column& column = columns_[size_t(set - 1)];
    MultiOscSet names;
    for (size_t slot = 0; slot < names.size(); ++slot)
      names[slot] = column.boxes[slot]->text().toStdString();
    if (names == column.kept) continue;
    if (!kora::SaveMOSets(services_.user, set, names)) return false;
    column.kept = names;
  }
  return true;
}

void MultiOsc::reject() {
  if (!SaveMOSets()) services_.dialogs.Message(services_.user.path() + " can't be written", kTitle);
  QDialog::reject();
}

}  // namespace kora
