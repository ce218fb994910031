#pragma once

#include <QBoxLayout>
#include <QString>
#include <functional>
#include <string>
#include <string_view>

class QDialog;
class QLabel;
class QLineEdit;
class QPushButton;
class QToolButton;
class QWidget;

namespace kora {

// What the small forms are put together from. Widgets belong to `form`; `name` becomes the
// objectName, by which tests and screen readers find a control.

QString FormText(std::string_view text);

// A box of about `columns` digits or letters that takes `limit` characters.
QLineEdit* NewField(QWidget* form, const QString& name, int columns, int limit);
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

 private:
  QDialog* form_;
  bool any_ = false;
};

// Focus into the box with its text selected.
void FocusField(QLineEdit* field);

}  // namespace kora
