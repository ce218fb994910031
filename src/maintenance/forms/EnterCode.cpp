#include "maintenance/forms/EnterCode.h"

#include <QGridLayout>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>

#include "base/text.h"
#include "platform/dialogs.h"
#include "platform/qt/form_parts.h"

namespace kora {

EnterCode::EnterCode(EnterCodeServices services, QWidget* parent)
    : QDialog(parent),
      services_(std::move(services)),
      selection_(services_.files, services_.dataPath) {
  setObjectName("EnterCode");
  setWindowTitle("Code Selection");
  list1_ = new CodeList("List1", this);
  list1_->setAccessibleName("Codes");
  list1_->setSelectionMode(QAbstractItemView::SingleSelection);
  list1_->setMinimumWidth(fontMetrics().averageCharWidth() * 54);
  list1_->setMinimumHeight(fontMetrics().height() * 20);
  getCode_ = NewField(this, "GetCode", 10, 6);
  getCode_->installEventFilter(this);
  label4_ = NewLabel(this, {});
  label4_->setObjectName("Label4");
  label4_->setMinimumWidth(fontMetrics().averageCharWidth() * 36);
  label3_ = NewLabel(this, {});
  label3_->setObjectName("Label3");
  for (QLabel* label : {label4_, label3_}) label->setTextFormat(Qt::PlainText);

  auto* grid = new QGridLayout(this);
  grid->addWidget(NewLabel(this, "Co&des", list1_), 0, 0);
  grid->addWidget(list1_, 1, 0, 6, 1);
  grid->addWidget(NewLabel(this, "Type a &code and press ENTER", getCode_), 0, 1);
  grid->addWidget(getCode_, 1, 1, Qt::AlignLeft);
  grid->addWidget(label4_, 2, 1);
  grid->addWidget(label3_, 3, 1);
  auto* buttons = new ButtonRow(this);
  if (services_.view) buttons->Add("Command1", "&View Data", [this] { View(); });
  if (services_.select) buttons->Add("Command3", "&Select", [this] { Select(); });
  buttons->Add("Command2", "Close", [this] { reject(); });
  grid->setRowStretch(5, 1);
  grid->addLayout(buttons, 6, 1);
  grid->setColumnStretch(0, 1);
  setTabOrder(getCode_, list1_);
  getCode_->setFocus();

  connect(list1_, &QListWidget::currentRowChanged, this, [this](int row) { CodeChosen(row); });
  connect(list1_, &QListWidget::itemDoubleClicked, this, [this] {
    if (services_.view)
      View();
    else
      Select();
  });
}

void EnterCode::Fill() {
  selection_.Load();
  ShowCodes(services_.lastIndex);
}

void EnterCode::ShowCodes(int index) {
  std::vector<std::string> codes;
  CodeNames names;
  for (size_t i = 0; i < selection_.count(); ++i) {
    codes.push_back(selection_.CodeAt(i));
    names.emplace(codes.back(), selection_.NameAt(i));
  }
  {
    const QSignalBlocker quiet(list1_);
    list1_->Show(codes, names);
  }
  if (codes.empty()) return;
  list1_->SelectOnly(std::min(size_t(std::max(index, 0)), codes.size() - 1));
}

void EnterCode::CodeChosen(int index) {
  if (index < 0) return;
  services_.lastIndex = index;
  selection_.Choose(size_t(index));
  getCode_->setText(ToQt(selection_.CodeAt(size_t(index))));
  ShowChoice();
}

void EnterCode::ShowChoice() {
  label4_->setText(ToQt(selection_.Name()));
  label3_->setText(ToQt(selection_.Label()));
}

void EnterCode::CodeTyped() {
  TellErrors(services_.dialogs, "Code Selection", [this] {
    std::optional<size_t> moveTo;
    if (!selection_.Enter(getCode_->text().toStdString(), services_.dialogs, moveTo)) return;
    if (moveTo) list1_->SelectOnly(*moveTo);
    ShowChoice();
  });
  getCode_->selectAll();
}

void EnterCode::View() {
  if (selection_.CurrentDataFile().empty())
    services_.dialogs.Message("No File For That Name", "Name File");
  else
    services_.view(selection_, this);
}

void EnterCode::Select() {
  if (selection_.CurrentDataFile().empty())
    services_.dialogs.Message("No File For That Name", "Name File");
  else
    services_.select(FromAnsi(selection_.CurrentCode()));
}

// Coming back to the form, names that another program changed are read again.
bool EnterCode::event(QEvent* event) {
  if (event->type() == QEvent::WindowActivate && selection_.Changed())
    TellErrors(services_.dialogs, "Code Selection", [this] {
      const std::string code = FromAnsi(selection_.CurrentCode());
      selection_.Load();
      int index = services_.lastIndex;
      for (size_t i = 0; i < selection_.count(); ++i)
        if (selection_.CodeAt(i) == code) {
          index = int(i);
          break;
        }
      ShowCodes(index);
    });
  return QDialog::event(event);
}

bool EnterCode::eventFilter(QObject* object, QEvent* event) {
  if (object == getCode_ && event->type() == QEvent::KeyPress) {
    const int key = static_cast<QKeyEvent*>(event)->key();
    if (key == Qt::Key_Return || key == Qt::Key_Enter) {
      CodeTyped();
      return true;
    }
  }
  return QDialog::eventFilter(object, event);
}

}  // namespace kora
