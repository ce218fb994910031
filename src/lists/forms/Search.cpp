#include "lists/forms/Search.h"

#include <QGridLayout>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>
#include <algorithm>

#include "lists/forms/list_box.h"

namespace kora {

Search::Search(const Files& files, Dialogs& dialogs, const std::string& dataPath,
               const std::string& text, QWidget* parent)
    : QDialog(parent) {
  setObjectName("Search");
  setWindowTitle("Search by Name");
  auto* grid = new QGridLayout(this);
  const char* captions[] = {"Code", " Chart Name"};
  const int widths[] = {10, 45};
  for (int i = 0; i < 2; ++i) {
    text1_[i] = new QLineEdit(this);
    text1_[i]->setObjectName(QString("Text1(%1)").arg(i));
    text1_[i]->setReadOnly(true);
    text1_[i]->setAccessibleName(QString(captions[i]).trimmed());
    text1_[i]->setFocusPolicy(Qt::ClickFocus);
    text1_[i]->setMinimumWidth(fontMetrics().averageCharWidth() * widths[i]);
    grid->addWidget(new QLabel(captions[i], this), 0, i);
    grid->addWidget(text1_[i], 1, i);
  }
  grid->setColumnStretch(1, 1);
  list1_ = new QListWidget(this);
  list1_->setObjectName("List1");
  list1_->setAccessibleName("Matches");
  list1_->setUniformItemSizes(true);
  grid->addWidget(list1_, 2, 0, 1, 2);
  grid->setRowStretch(2, 1);
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
  grid->addLayout(buttons, 3, 0, 1, 2);
  next->setFocus();
  connect(next, &QPushButton::clicked, this, [this] { FindNext(); });
  connect(select, &QPushButton::clicked, this, &QDialog::accept);
  connect(close, &QPushButton::clicked, this, &QDialog::reject);
  connect(list1_, &QListWidget::currentRowChanged, this, [this](int row) {
    if (row < 0) return;
    chosen_ = row;
    ShowMatch();
  });
  connect(list1_, &QListWidget::itemDoubleClicked, this, &QDialog::accept);
  TellErrors(dialogs, "Search by Name", [&] { matches_ = NamesWith(files, dataPath, text); });
  for (const NameMatch& match : matches_)
    list1_->addItem(QString::fromStdString(match.code + "\t" + match.name));
  list1_->setCurrentRow(0);
  ShowMatch();
}

std::optional<NameMatch> Search::match() const {
  if (chosen_ >= int(matches_.size())) return std::nullopt;
  return matches_[size_t(chosen_)];
}

void Search::ShowMatch() {
  const auto shown = match();
  text1_[0]->setText(QString::fromStdString(shown ? shown->code : std::string()));
  text1_[1]->setText(QString::fromStdString(shown ? shown->name : std::string(kNoMoreMatches)));
}

void Search::FindNext() {
  chosen_ = std::min(chosen_ + 1, int(matches_.size()));
  list1_->setCurrentRow(chosen_ < int(matches_.size()) ? chosen_ : -1);
  ShowMatch();
}

}  // namespace kora
