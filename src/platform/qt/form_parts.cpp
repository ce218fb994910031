#include "platform/qt/form_parts.h"

#include <QAction>
#include <QDialog>
#include <QGridLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPointer>
#include <QPushButton>
#include <QScreen>
#include <QSpinBox>
#include <QStyle>
#include <QToolButton>

namespace kora {

QLineEdit* NewField(QWidget* form, const QString& name, int columns, int limit) {
  auto* field = new QLineEdit(form);
  field->setObjectName(name);
  field->setMaxLength(limit);
  const QFontMetrics metrics = form->fontMetrics();
  const int width = metrics.horizontalAdvance(QString(columns + 2, '0'));
  field->setMinimumWidth(width);
  // A short box stays short where its column is wide.
  if (columns <= 12) field->setMaximumWidth(width);
  return field;
}

QSpinBox* NewNumber(QWidget* form, const QString& name, int least, int most, int value) {
  auto* field = new QSpinBox(form);
  field->setObjectName(name);
  field->setRange(least, most);
  field->setValue(value);
  return field;
}

QLabel* NewLabel(QWidget* form, const QString& caption, QWidget* buddy) {
  auto* label = new QLabel(caption, form);
  if (buddy) label->setBuddy(buddy);
  return label;
}

QLabel* NewNote(QWidget* form, const QString& text, int columns) {
  auto* label = new QLabel(text, form);
  label->setTextFormat(Qt::PlainText);
  label->setWordWrap(true);
  label->setMinimumWidth(form->fontMetrics().averageCharWidth() * columns);
  return label;
}

QToolButton* NewFolderButton(QWidget* form, const QString& name, std::function<void()> pressed) {
  auto* button = new QToolButton(form);
  button->setObjectName(name);
  button->setIcon(form->style()->standardIcon(QStyle::SP_DirOpenIcon));
  button->setToolTip("Choose the folder");
  button->setAccessibleName("Choose the folder");
  button->setFocusPolicy(Qt::TabFocus);
  QObject::connect(button, &QToolButton::clicked, form,
                   [pressed = std::move(pressed)] { pressed(); });
  return button;
}

ButtonRow::ButtonRow(QDialog* form) : form_(form) { addStretch(); }

QPushButton* ButtonRow::Add(const QString& name, const QString& caption,
                            std::function<void()> pressed) {
  auto* button = new QPushButton(caption, form_);
  button->setObjectName(name);
  button->setDefault(!any_);
  any_ = true;
  addWidget(button);
  QObject::connect(button, &QPushButton::clicked, form_,
                   [pressed = std::move(pressed)] { pressed(); });
  return button;
}

QPushButton* ButtonRow::AddOkCancel(std::function<void()> ok) {
  QPushButton* button = Add("Command1", "&OK", std::move(ok));
  Add("Command2", "&Cancel", [form = form_] { form->reject(); });
  return button;
}

QPushButton* AddOkCancel(QDialog* form, QGridLayout* grid, std::function<void()> ok) {
  grid->setRowStretch(grid->rowCount(), 1);
  auto* buttons = new ButtonRow(form);
  QPushButton* button = buttons->AddOkCancel(std::move(ok));
  grid->addLayout(buttons, grid->rowCount(), 0, 1, -1);
  return button;
}

void RunForm(QDialog* form) {
  struct Owner {
    QPointer<QDialog> form;
    ~Owner() { delete form.data(); }
  } owner{form};
  form->exec();
}

QAction* AddEntry(QWidget* form, QWidget* menu, const QString& name, const QString& caption,
                  std::function<void()> chosen) {
  auto* action = new QAction(caption, menu);
  action->setObjectName(name);
  QObject::connect(action, &QAction::triggered, form, std::move(chosen));
  menu->addAction(action);
  return action;
}

void SizeInLetters(QWidget* form, int columns, int lines) {
  const QFontMetrics metrics = form->fontMetrics();
  form->resize(QSize(metrics.averageCharWidth() * columns, metrics.height() * lines)
                   .boundedTo(form->screen()->availableSize() * 0.9));
}

void ForgetBoxes(QWidget* form) {
  for (QLineEdit* box : form->findChildren<QLineEdit*>()) box->disconnect(form);
}

void FocusField(QLineEdit* field) {
  field->setFocus(Qt::OtherFocusReason);
  field->selectAll();
}

void FocusField(QSpinBox* field) {
  field->setFocus(Qt::OtherFocusReason);
  field->selectAll();
}

}  // namespace kora
