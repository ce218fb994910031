#include "adjust/forms/figure_form.h"

#include <QApplication>
#include <QGridLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QScreen>
#include <QStyle>
#include <algorithm>

#include "base/runtime_error.h"
#include "platform/qt/form_parts.h"

namespace kora {

void StandBeside(QWidget* window, const QWidget* other) {
  const QRect room = other->screen()->availableGeometry();
  const QRect beside = other->frameGeometry();
  const int right = room.right() - window->frameGeometry().width();
  window->move(std::max(room.left(), std::min(beside.right() + 1, right)), beside.top());
}

FigureForm::FigureForm(FigureFormServices services, IssueKind kind, const Texts& texts,
                       QWidget* parent)
    : QDialog(parent),
      services_(std::move(services)),
      work_(services_.adjust, kind),
      lineSetsDate_(texts.lineSetsDate),
      tellsTypedDate_(texts.tellsTypedDate) {
  setObjectName(texts.name);
  setWindowTitle(texts.caption);
  auto* grid = new QGridLayout(this);
  if (texts.first) first_ = AddBox(grid, "Text1", texts.first);
  if (texts.second) second_ = AddBox(grid, "Text2", texts.second);
  if (texts.amount) amount_ = AddBox(grid, "Text4", texts.amount);
  date_ = NewField(this, "Text3", 12, 12);
  grid->addWidget(NewLabel(this, "Da&te  d/m/yy", date_), grid->rowCount(), 0);
  grid->addWidget(date_, grid->rowCount() - 1, 1);
  for (const QString& hint : texts.hints)
    grid->addWidget(NewNote(this, hint), grid->rowCount(), 0, 1, 3);
  state_ = NewLabel(this, "");
  state_->setObjectName("Label1");
  state_->setTextFormat(Qt::PlainText);
  grid->addWidget(state_, grid->rowCount(), 0, 1, 3);
  grid->setRowStretch(grid->rowCount(), 1);
  grid->setColumnStretch(2, 1);

  auto* buttons = new ButtonRow(this);
  check_ = buttons->Add("Command3", "C&heck Date", [this] { CheckDate(); });
  adjust_ = buttons->Add("Command1", "&Adjust Data", [this] { AdjustData(); });
  auto* close = buttons->Add("Command2", "&Close", [this] { reject(); });
  // A click on it must not ask for the figures that are given up.
  close->setFocusPolicy(Qt::TabFocus);
  grid->addLayout(buttons, grid->rowCount(), 0, 1, 3);
  adjust_->setEnabled(false);

  connect(date_, &QLineEdit::textEdited, this, [this] { Forget(); });
  FocusField(first_ ? first_ : amount_);
}

FigureForm::~FigureForm() { ForgetBoxes(this); }

QLineEdit* FigureForm::AddBox(QGridLayout* grid, const char* name, const char* caption) {
  QLineEdit* box = NewField(this, name, 10, 20);
  const int row = grid->rowCount();
  grid->addWidget(NewLabel(this, caption, box), row, 0);
  grid->addWidget(box, row, 1);
  connect(box, &QLineEdit::editingFinished, this, [this, box] { Left(box); });
  return box;
}

// Nothing, and the focus back in the box, where its text is no number.
std::optional<double> FigureForm::NumberIn(QLineEdit* box) {
  if (!box) return 0.0;
  const auto number = FieldNumber(box->text().toStdString());
  if (number || telling_) return number;
  telling_ = true;  // the message takes the focus, which leaves the box once more
  QApplication::beep();
  services_.adjust.dialogs.Message(kMustBeNumeric, " Data Input ");
  telling_ = false;
  FocusField(box);
  return std::nullopt;
}

void FigureForm::Left(QLineEdit* box) {
  if (isVisible() && NumberIn(box)) ShowRatio();
}

std::optional<IssueFigures> FigureForm::Figures() {
  const auto first = NumberIn(first_);
  if (!first) return std::nullopt;
  const auto second = NumberIn(second_);
  if (!second) return std::nullopt;
  const auto amount = NumberIn(amount_);
  if (!amount) return std::nullopt;
  try {
    return IssueFigures{float(*first), float(*second), Currency(*amount)};
  } catch (const RunTimeError& e) {
    services_.adjust.dialogs.Message(e.what(), " Data Input ");
    FocusField(amount_);
    return std::nullopt;
  }
}

void FigureForm::ShowRatio() {
  if (!second_) return;
  const auto first = FieldNumber(first_->text().toStdString());
  const auto second = FieldNumber(second_->text().toStdString());
  if (!first || !second) return;
  const std::string ratio = RatioText({float(*first), float(*second), {}});
  if (!ratio.empty()) state_->setText(ToQt(ratio));
}

void FigureForm::Forget() {
  work_.Forget();
  AdjRecNo_ = 0;
  if (list_) list_->close();
  check_->setEnabled(true);
  check_->setDefault(true);
  adjust_->setEnabled(false);
}

void FigureForm::CheckDate() {
  const auto figures = Figures();
  if (!figures) return;
  Forget();
  const std::string typed = date_->text().toStdString();
  if (!work_.CheckDate(services_.code(), *figures, typed,
                       tellsTypedDate_ ? typed : std::string())) {
    FocusField(date_);
    return;
  }
  date_->setText(ToQt(work_.date()));
  list_ = new AdjDate(
      work_.dates(), [this](int line) { LineChosen(line); }, this);
  list_->setAttribute(Qt::WA_DeleteOnClose);
  list_->show();
  const QRect below = frameGeometry();
  list_->move(below.left(), below.bottom() + style()->pixelMetric(QStyle::PM_TitleBarHeight));
  LineChosen(int(work_.dates().Selected));
  adjust_->setEnabled(true);
  adjust_->setDefault(true);
  check_->setEnabled(false);
}

void FigureForm::LineChosen(int line) {
  if (line < 0) return;
  AdjRecNo_ = work_.dates().AdjRecNo(size_t(line));
  if (lineSetsDate_) date_->setText(ToQt(work_.DateOfLine(size_t(line))));
}

void FigureForm::AdjustData() {
  const auto figures = Figures();
  if (!figures) return;
  const bool done = work_.Adjust(*figures, AdjRecNo_, [this](const std::string& desc) {
    state_->setText(ToQt("Adjustment Desc :" + desc));
  });
  if (!done) return;
  const auto adjusted = services_.adjusted;
  accept();
  if (adjusted) adjusted();
}

void FigureForm::done(int result) {
  if (list_) list_->close();
  QDialog::done(result);
}

}  // namespace kora
