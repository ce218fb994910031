#pragma once

#include <QDialog>
#include <QPointer>
#include <functional>

#include "adjust/forms/AdjDate.h"
#include "adjust/issue_adjustment.h"

class QGridLayout;
class QLabel;
class QLineEdit;
class QPushButton;

namespace kora {

// Moves a window to the right of another, top by top, as far as the screen has room: both can be
// used.
void StandBeside(QWidget* window, const QWidget* other);

// What a form of figures is told by `Adjust`.
struct FigureFormServices {
  AdjustServices adjust;
  std::function<std::string()> code;  // of the security on show
  std::function<void()> adjusted;     // done and told; the form is closed
};

// What the five forms of figures have in common: one or two ratio figures, an amount, the date
// and its look-up. Each kind gives its texts.
class FigureForm : public QDialog {
 public:
  ~FigureForm() override;
  // Another security is on show: what was looked up is forgotten.
  void SecurityChanged() { Forget(); }
  void done(int result) override;

 protected:
  struct Texts {
    const char* name;  // of the form
    const char* caption;
    QStringList hints;
    const char* first = nullptr;  // captions of the boxes; none, no box
    const char* second = nullptr;
    const char* amount = nullptr;
    bool lineSetsDate = false;  // the line chosen is written into the date box
    bool tellsTypedDate = true;
  };
  FigureForm(FigureFormServices services, IssueKind kind, const Texts& texts, QWidget* parent);

 private:
  QLineEdit* AddBox(QGridLayout* grid, const char* name, const char* caption);
  // Reads the boxes; nothing after a message, the box at fault having the focus.
  std::optional<IssueFigures> Figures();
  std::optional<double> NumberIn(QLineEdit* box);
  void Left(QLineEdit* box);
  void ShowRatio();
  void CheckDate();
  void LineChosen(int line);
  void AdjustData();
  void Forget();

  FigureFormServices services_;
  IssueAdjustment work_;
  const bool lineSetsDate_, tellsTypedDate_;
  QLineEdit *first_ = nullptr, *second_ = nullptr, *amount_ = nullptr, *date_;
  QLabel* state_;
  QPushButton *check_, *adjust_;
  QPointer<AdjDate> list_;
  std::int16_t AdjRecNo_ = 0;
  bool telling_ = false;
};

}  // namespace kora
