#include "lists/forms/Search.h"

#include <QGridLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>

#include "lists/forms/list_box.h"

namespace kora {

Search::Search(const Files& files, Dialogs& dialogs, const std::string& dataPath,
               const std::string& text, QWidget* parent)
    : QDialog(parent), dialogs_(dialogs), search_(files, dataPath, text) {
  setObjectName("Search");
  setWindowTitle("Search by Name");
  auto* grid = new QGridLayout(this);
  const char* captions[] = {"Code", " Chart Name"};
  const int widths[] = {10, 45};
  for (int i = 0; i < 2; ++i) {
    text1_[i] = new QLineEdit(this);
    text1_[i]->setObjectName(QString("Text1(%1)").arg(i));
    text1_[i]->setReadOnly(true);
    text1_[i]->setFocusPolicy(Qt::ClickFocus);
    text1_[i]->setMinimumWidth(fontMetrics().averageCharWidth() * widths[i]);
    grid->addWidget(new QLabel(captions[i], this), 0, i);
    grid->addWidget(text1_[i], 1, i);
  }
  grid->setColumnStretch(1, 1);
  auto* next = new QPushButton("Find &Next", this);
  next->setObjectName("Command1");
  next->setDefault(true);
  auto* select = new QPushButton("&Select", this);
  select->setObjectName("Command3");
  auto* close = new QPushButton("&Close", this);
  close->setObjectName("Command2");
  auto* buttons = new QHBoxLayout;
  buttons->addStretch();
  for (QPushButton* button : {next, select, close}) buttons->addWidget(button);
  grid->addLayout(buttons, 2, 0, 1, 2);
  grid->setRowStretch(3, 1);
  next->setFocus();
  connect(next, &QPushButton::clicked, this, [this] { FindNext(); });
  connect(select, &QPushButton::clicked, this, &QDialog::accept);
  connect(close, &QPushButton::clicked, this, &QDialog::reject);
  FindNext();
}

void Search::FindNext() {
  match_.reset();
  TellErrors(dialogs_, "Search by Name", [this] { match_ = search_.FindNext(); });
  text1_[0]->setText(match_ ? QString::fromStdString(match_->code) : QString());
  text1_[1]->setText(QString::fromStdString(match_ ? match_->name : std::string(kNoMoreMatches)));
}

}  // namespace kora
