#include "platform/qt/form_parts.h"

#include <QDialog>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QStyle>
#include <QToolButton>

namespace kora {

QString FormText(std::string_view text) {
  return QString::fromUtf8(text.data(), qsizetype(text.size()));
}

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

void FocusField(QLineEdit* field) {
  field->setFocus(Qt::OtherFocusReason);
  field->selectAll();
}

}  // namespace kora
