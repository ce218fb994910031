#pragma once

#include <QBoxLayout>
#include <QString>
#include <functional>

#include "platform/qt/to_qt.h"

class QAction;
class QDialog;
class QGridLayout;
class QLabel;
class QLineEdit;
class QPushButton;
class QSpinBox;
class QToolButton;
class QWidget;

namespace kora {

// What the small forms are put together from. Widgets belong to `form`; `name` becomes the
// objectName, by which tests and screen readers find a control.

// A box of about `columns` digits or letters that takes `limit` characters.
QLineEdit* NewField(QWidget* form, const QString& name, int columns, int limit);
// A box of whole numbers from `least` to `most`.
QSpinBox* NewNumber(QWidget* form, const QString& name, int least, int most, int value);
// A label; with a buddy its mnemonic leads there.
QLabel* NewLabel(QWidget* form, const QString& caption, QWidget* buddy = nullptr);
// A label for sentences: it wraps at about `columns` letters.
QLabel* NewNote(QWidget* form, const QString& text, int columns = 46);

// The small button beside a box by which its folder is chosen.
QToolButton* NewFolderButton(QWidget* form, const QString& name, std::function<void()> pressed);

// The buttons at the foot of a form. Enter presses the first one added, or the one that has the
// focus.
class ButtonRow : public QHBoxLayout {
 public:
  explicit ButtonRow(QDialog* form);
  QPushButton* Add(const QString& name, const QString& caption, std::function<void()> pressed);
  // "OK" (`Command1`) and "Cancel" (`Command2`), which rejects the form. Returns the first.
  QPushButton* AddOkCancel(std::function<void()> ok);

 private:
  QDialog* form_;
  bool any_ = false;
};

// Ends a form that is laid out in `grid`: below what is there a row that takes the height to
// spare, and below that OK and Cancel. Returns the OK button.
QPushButton* AddOkCancel(QDialog* form, QGridLayout* grid, std::function<void()> ok);

// Runs a modal form until it is left and takes it down, also where an exception ends it. The form
// may go with its parent before that; then nothing is left to take down.
void RunForm(QDialog* form);

// An entry of a menu or of a menu bar; `chosen` is not called once the form is gone.
QAction* AddEntry(QWidget* form, QWidget* menu, const QString& name, const QString& caption,
                  std::function<void()> chosen);

// As wide as `columns` letters and as high as `lines` of them, where the screen has that room.
void SizeInLetters(QWidget* form, int columns, int lines);

// For the destructor of a form: a box that loses the focus as its form goes has nobody left to
// tell that it was edited.
void ForgetBoxes(QWidget* form);

// Focus into the box with its text selected.
void FocusField(QLineEdit* field);
void FocusField(QSpinBox* field);

}  // namespace kora
