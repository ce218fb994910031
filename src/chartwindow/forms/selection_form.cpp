#include "chartwindow/forms/selection_form.h"

#include <QComboBox>
#include <QGridLayout>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QMouseEvent>
#include <QPushButton>
#include <QScreen>
#include <QScrollBar>
#include <QSignalBlocker>
#include <QToolButton>

namespace kora {

SelectionForm::SelectionForm(const char* name, const QString& title, ChtSelServices services,
                             QWidget* parent)
    : QDialog(parent), services_(std::move(services)) {
  setObjectName(name);
  setWindowTitle(title);

  label8_ = new QLabel(this);
  label8_->setObjectName("Label8");
  label8_->setTextFormat(Qt::PlainText);
  QFont bold = label8_->font();
  bold.setBold(true);
  label8_->setFont(bold);

  text1_ = AddShown("Text1", 10);
  connect(text1_, &QLineEdit::textEdited, this, [this] {
    typed_ = true;
    style_.reset();
    period_.reset();
  });
  text2_ = AddShown("Text2", 38);
  text4_ = AddShown("Text4", 8);
  text5_ = AddShown("Text5", 8);
  for (QLineEdit* count : {text4_, text5_}) {
    count->setReadOnly(true);
    count->setFocusPolicy(Qt::NoFocus);
    count->setAlignment(Qt::AlignRight);
  }
  vScroll1_ = new QScrollBar(Qt::Vertical, this);
  vScroll1_->setObjectName("VScroll1");
  vScroll1_->setAccessibleName("This Chart");
  vScroll1_->setFocusPolicy(Qt::StrongFocus);
  vScroll1_->setTracking(false);
  vScroll1_->setMinimumHeight(fontMetrics().height() * 4);
  connect(vScroll1_, &QScrollBar::valueChanged, this, [this](int value) {
    services_.selection.Scroll(std::int16_t(value));
    Refresh();
  });

  combo1_ = new QComboBox(this);
  combo1_->setObjectName("Combo1");
  combo1_->addItems({"Bar", "Candlestick", "Line", "Point & Figure"});
  connect(combo1_, &QComboBox::activated, this, [this](int index) {
    style_ = index;
    services_.selection.ChooseStyle(index);
    Refresh();
  });
  combo4_ = new QComboBox(this);
  combo4_->setObjectName("Combo4");
  combo4_->addItems({"Daily", "Weekly", "Monthly"});
  connect(combo4_, &QComboBox::activated, this, [this](int index) {
    period_ = index;
    services_.selection.ChoosePeriod(index);
    Refresh();
  });

  text3_ = AddShown("Text3", 6);
  text3_->setAccessibleName("Spacing");
  label4_ = AddCaption("Chart &Spacing", text3_);
  label4_->setObjectName("Label4");
  connect(text3_, &QLineEdit::textEdited, this,
          [this](const QString& text) { services_.selection.TypeSpacing(text.toStdString()); });

  ok_ = AddButton("OK", "SHOW C&HART");
  command2_ = AddButton("Command2", "Clos&e");
  connect(ok_, &QPushButton::clicked, this, [this] { ShowChart(); });
  connect(command2_, &QPushButton::clicked, this, [this] { Leave(); });
}

QPushButton* SelectionForm::AddButton(const char* name, const char* caption) {
  auto* button = new QPushButton(caption, this);
  button->setObjectName(name);
  button->setAutoDefault(false);
  return button;
}

QLabel* SelectionForm::AddCaption(const char* caption, QWidget* buddy) {
  auto* label = new QLabel(caption, this);
  label->setBuddy(buddy);
  return label;
}

QLineEdit* SelectionForm::AddShown(const char* name, int characters) {
  auto* field = new QLineEdit(this);
  field->setObjectName(name);
  field->setMinimumWidth(fontMetrics().averageCharWidth() * characters);
  field->installEventFilter(this);
  return field;
}

QGridLayout* SelectionForm::SecurityRow() {
  auto* grid = new QGridLayout;
  grid->addWidget(AddCaption("&Code", text1_), 0, 0, Qt::AlignBottom);
  grid->addWidget(AddCaption(" Chart &Name", text2_), 0, 1, Qt::AlignBottom);
  grid->addWidget(new QLabel("Total Charts", this), 0, 2, Qt::AlignBottom);
  grid->addWidget(new QLabel("This Chart", this), 0, 3, Qt::AlignBottom);
  grid->addWidget(text1_, 1, 0);
  grid->addWidget(text2_, 1, 1);
  grid->addWidget(text4_, 1, 2);
  grid->addWidget(text5_, 1, 3);
  grid->addWidget(vScroll1_, 0, 4, 2, 1);
  grid->setColumnStretch(1, 1);
  return grid;
}

QWidget* SelectionForm::SpacingRow() {
  auto* row = new QWidget(this);
  auto* across = new QHBoxLayout(row);
  across->setContentsMargins(0, 0, 0, 0);
  across->setSpacing(0);
  across->addWidget(text3_);
  for (const bool up : {false, true}) {
    auto* arrow = new QToolButton(row);
    arrow->setObjectName(up ? "UpDown2(1)" : "UpDown2(0)");
    arrow->setArrowType(up ? Qt::UpArrow : Qt::DownArrow);
    arrow->setAccessibleName(up ? "More" : "Less");
    arrow->setAutoRepeat(true);
    arrow->setFocusPolicy(Qt::NoFocus);
    connect(arrow, &QToolButton::clicked, this, [this, up] { Step(up); });
    across->addWidget(arrow);
  }
  return row;
}

void SelectionForm::Step(bool up) {
  services_.selection.StepSpacing(up);
  Refresh();
}

void SelectionForm::Refresh() {
  const ChartSelectionView& view = services_.selection.view();
  const auto set = [](QLineEdit* field, const std::string& text) {
    const QString value = QString::fromStdString(text);
    if (field->text() != value) field->setText(value);
    if (!field->hasFocus()) field->setCursorPosition(0);
  };
  label8_->setText(QString::fromStdString(view.Label8));
  if (!typed_ || view.Text1 != shown_) {
    typed_ = false;
    shown_ = view.Text1;
    set(text1_, view.Text1);
  }
  set(text2_, view.Text2);
  set(text3_, view.Text3);
  set(text4_, view.Text4);
  set(text5_, view.Text5);
  label4_->setText(view.Label4 == "Chart Spacing" ? "Chart &Spacing" : "Point &Reversal");
  const QSignalBlocker quiet(vScroll1_);
  vScroll1_->setRange(1, view.VScrollMax);
  vScroll1_->setPageStep(std::max(1, view.VScrollMax / 20));
  vScroll1_->setValue(view.VScroll1);
  combo1_->setCurrentIndex(view.Combo1);
  combo4_->setCurrentIndex(view.Combo4);
}

void SelectionForm::FocusCode() {
  text1_->setFocus();
  text1_->selectAll();
}

void SelectionForm::ShowChart() {
  // A mnemonic presses the button without taking the focus from the spacing.
  if (text3_->hasFocus()) services_.selection.LeaveSpacing();
  if (!EnterTyped()) return;
  if (!services_.selection.OK()) return;
  // Closing this form may delete it: what is still called must not live in it.
  const ChtSelServices services = services_;
  QDialog::accept();
  services.dialogs.Yield();
  if (services.state.ChartStartup) {
    if (services.showWindow) services.showWindow();
    services.state.ChartStartup = false;
  }
  if (services.showChart) services.showChart();
}

void SelectionForm::reject() { command2_->click(); }

// A code that was typed and not entered is entered first; what was chosen for it since stays.
bool SelectionForm::EnterTyped() {
  if (!typed_ || text1_->text().trimmed().isEmpty()) return true;
  const auto style = style_, period = period_;
  if (!EnterCode()) return false;
  if (style) services_.selection.ChooseStyle(*style);
  if (period) services_.selection.ChoosePeriod(*period);
  return true;
}

// False where the code is not there; the focus is on it then.
bool SelectionForm::EnterCode() {
  const auto entered = services_.selection.EnterCode(text1_->text().toStdString());
  // What was typed stays where it led nowhere.
  typed_ = entered == ChartSelection::Entered::kNothing;
  Refresh();
  if (entered == ChartSelection::Entered::kFound) {
    ok_->setFocus();
    return true;
  }
  FocusCode();
  return false;
}

bool SelectionForm::FieldEnter(QObject* field) {
  if (field != text1_) return field == text3_;
  EnterCode();
  return true;
}

bool SelectionForm::eventFilter(QObject* object, QEvent* event) {
  if (event->type() == QEvent::KeyPress) {
    const int key = static_cast<QKeyEvent*>(event)->key();
    if ((key == Qt::Key_Return || key == Qt::Key_Enter) && FieldEnter(object)) return true;
    if (object == text3_ && (key == Qt::Key_Up || key == Qt::Key_Down)) {
      Step(key == Qt::Key_Up);
      return true;
    }
  } else if (object == text3_ && event->type() == QEvent::FocusOut) {
    services_.selection.LeaveSpacing();
    Refresh();
  } else if (const auto* mouse = dynamic_cast<QMouseEvent*>(event);
             mouse && mouse->button() == Qt::LeftButton && FieldMouse(object, event->type())) {
    return true;
  }
  return QDialog::eventFilter(object, event);
}

void SelectionForm::keyPressEvent(QKeyEvent* event) {
  switch (event->key()) {
    case Qt::Key_Return:
    case Qt::Key_Enter:
      if (auto* button = qobject_cast<QAbstractButton*>(focusWidget())) button->click();
      return;
    case Qt::Key_Escape: return Escape();
    case Qt::Key_PageUp: vScroll1_->triggerAction(QAbstractSlider::SliderSingleStepSub); return;
    case Qt::Key_PageDown: vScroll1_->triggerAction(QAbstractSlider::SliderSingleStepAdd); return;
    default: QDialog::keyPressEvent(event);
  }
}

// Near the upper left corner of the main window.
void SelectionForm::showEvent(QShowEvent* event) {
  QDialog::showEvent(event);
  if (placed_) return;
  placed_ = true;
  FocusCode();
  if (!parentWidget()) return;
  const QRect main = parentWidget()->window()->frameGeometry();
  const QRect room = screen()->availableGeometry();
  const int left = main.left() + qRound(main.width() * 0.006);
  const int top = main.top() + qRound(main.height() * 0.077);
  move(std::max(room.left(), std::min(left, room.right() - frameGeometry().width())),
       std::max(room.top(), std::min(top, room.bottom() - frameGeometry().height())));
}

}  // namespace kora
