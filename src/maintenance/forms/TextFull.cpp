#include "maintenance/forms/TextFull.h"

#include <QCheckBox>
#include <QGridLayout>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <algorithm>

#include "base/text.h"
#include "lists/forms/list_box.h"
#include "maintenance/text_exports.h"
#include "platform/qt/form_parts.h"

namespace kora {

TextFull::TextFull(MaintenanceServices services, QWidget* parent)
    : WorkForm(std::move(services), parent) {
  setObjectName("TextFull");
  setWindowTitle("Create Text File of Closing Prices");
  auto* rows = new QVBoxLayout(this);
  for (const char* text : {"This procedure creates a Text file of closing prices for a stock.",
                           "The text file created will be code.txt  (eg AAA.txt ) ",
                           "and will be located in \\korawin\\chtmisc  folder."})
    rows->addWidget(NewNote(this, text, 60));
  auto* grid = new QGridLayout;
  text7_ = NewField(this, "Text7", 8, 6);
  text7_->installEventFilter(this);
  text8_ = NewShown(this, "Text8", 34);
  text8_->setAccessibleName("Name");
  grid->addWidget(NewLabel(this, "Co&de", text7_), 0, 0);
  grid->addWidget(NewLabel(this, "Name"), 0, 2);
  grid->addWidget(text7_, 1, 0);
  grid->addWidget(NewStepper(this, "VScroll1", [this](int by) { Step(by); }), 1, 1);
  grid->addWidget(text8_, 1, 2);
  grid->setColumnStretch(2, 1);
  rows->addLayout(grid);
  rows->addWidget(NewLabel(this, "Format"));
  boxes_.emplace(this, rows, "Code,Date,&O,H,L,C,V", "Code    Date    O    &H    L    C    V");
  label3_ = new QLabel(this);
  label3_->setObjectName("Label3");
  label3_->setTextFormat(Qt::PlainText);
  rows->addWidget(label3_);
  rows->addStretch();
  auto* buttons = new ButtonRow(this);
  buttons->Add("Command1", "Create &Text File", [this] { Create(); });
  auto* close = buttons->Add("Command2", "&Close", [this] { reject(); });
  close->setAutoDefault(false);
  // Leaving by the mouse must not look a half-typed code up.
  close->setFocusPolicy(Qt::TabFocus);
  rows->addLayout(buttons);
  connect(text7_, &QLineEdit::editingFinished, this, [this] {
    if (text7_->isModified()) FindTyped();
  });
}

bool TextFull::Fill() {
  if (!TellErrors(services_.dialogs, "Create Text File",
                  [this] { names_ = ReadNames(services_.files, dataPath()); }))
    return false;
  if (names_.empty()) {
    services_.dialogs.Message("No Records in Name File", "Create Text File");
    return false;
  }
  Show(0);
  return true;
}

void TextFull::Show(size_t place) {
  place_ = place;
  const NameRec& rec = names_[place_];
  text7_->setText(ToQt(FromAnsi(Trim(rec.Code.trimmed()))));
  text8_->setText(ToQt(FromAnsi(Trim(rec.Name.trimmed()))));
  text8_->setCursorPosition(0);
  label3_->clear();
}

void TextFull::Step(int by) {
  const auto last = std::ptrdiff_t(names_.size()) - 1;
  Show(size_t(std::clamp(std::ptrdiff_t(place_) + by, std::ptrdiff_t(0), last)));
}

bool TextFull::FindTyped() {
  text7_->setModified(false);
  const std::string code = UCase(Trim(ToAnsi(text7_->text().toStdString())));
  for (size_t i = 0; i < names_.size(); ++i) {
    if (UCase(Trim(names_[i].Code.trimmed())) != code) continue;
    Show(i);
    return true;
  }
  services_.dialogs.Message(" File not found", "Data Entry");
  Show(place_);
  FocusField(text7_);
  return false;
}

// Enter in the code shows its security and creates nothing.
bool TextFull::eventFilter(QObject* object, QEvent* event) {
  if (object == text7_ && event->type() == QEvent::KeyPress) {
    const int key = static_cast<QKeyEvent*>(event)->key();
    if (key == Qt::Key_Return || key == Qt::Key_Enter) {
      FindTyped();
      text7_->selectAll();
      return true;
    }
  }
  return QDialog::eventFilter(object, event);
}

void TextFull::Create() {
  if (text7_->isModified() && !FindTyped()) return;
  label3_->clear();
  const auto made =
      ExportHistory(services_.files, dataPath(), services_.settings.paths.ChartMiscPath,
                    Trim(names_[place_].Code.trimmed()), boxes_->form(), services_.dialogs);
  if (!made) return;
  label3_->setText(ToQt("Text File " + FromAnsi(*made) + " created"));
  // Texts of the chart on show may have been replaced.
  SetChanged();
}

}  // namespace kora
