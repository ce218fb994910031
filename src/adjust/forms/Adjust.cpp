#include "adjust/forms/Adjust.h"

#include <QEvent>
#include <QGridLayout>
#include <QGroupBox>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QRadioButton>
#include <QToolButton>
#include <utility>

#include "adjust/forms/AdjustB.h"
#include "adjust/forms/AdjustC.h"
#include "adjust/forms/AdjustCC.h"
#include "adjust/forms/AdjustD.h"
#include "adjust/forms/AdjustR.h"
#include "adjust/forms/AdjustSS.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "lists/forms/list_box.h"
#include "platform/qt/form_parts.h"

namespace kora {
namespace {

constexpr const char* kTitle = "Adjustments for Issues";
constexpr const char* kKinds[] = {"&Bonus Issue", "&Cash Issue",
                                  "&Share Split", "C&alls on Contributing Shares",
                                  "&Dividend",    "&Remove Adjustment"};

QLineEdit* Shown(QWidget* form, const char* name, int columns) {
  QLineEdit* box = NewField(form, name, columns, 80);
  box->setReadOnly(true);
  box->setFocusPolicy(Qt::ClickFocus);
  return box;
}

}  // namespace

Adjust::Adjust(AdjustFormServices services, QWidget* parent)
    : QDialog(parent), services_(std::move(services)) {
  setObjectName("Adjust");
  setWindowTitle(kTitle);
  auto* grid = new QGridLayout(this);
  text7_ = Shown(this, "Text7", 8);
  text8_ = Shown(this, "Text8", 34);
  grid->addWidget(NewLabel(this, "Code"), 0, 0);
  grid->addWidget(NewLabel(this, "Name"), 0, 2);
  grid->addWidget(text7_, 1, 0);
  auto* arrows = new QVBoxLayout;
  arrows->setSpacing(0);
  for (const bool up : {true, false}) {
    auto* arrow = new QToolButton(this);
    arrow->setObjectName(up ? "UpDown1(1)" : "UpDown1(0)");
    arrow->setArrowType(up ? Qt::UpArrow : Qt::DownArrow);
    arrow->setAccessibleName(up ? "Next security" : "Previous security");
    arrow->setToolTip(arrow->accessibleName());
    arrow->setFocusPolicy(Qt::StrongFocus);
    arrow->setAutoRepeat(true);
    connect(arrow, &QToolButton::clicked, this, [this, up] { Step(up ? 1 : -1); });
    arrows->addWidget(arrow);
  }
  grid->addLayout(arrows, 1, 1);
  grid->addWidget(text8_, 1, 2);

  auto* box = new QGroupBox("Kind of Issue", this);
  auto* column = new QVBoxLayout(box);
  for (int i = 0; i < 6; ++i) {
    options_[i] = new QRadioButton(kKinds[i], box);
    options_[i]->setObjectName(QString("Option%1").arg(i + 1));
    // One that was chosen before opens its form again.
    connect(options_[i], &QRadioButton::clicked, this, [this, i] { OpenKind(i); });
    column->addWidget(options_[i]);
  }
  grid->addWidget(box, 2, 0, 1, 3);
  grid->setRowStretch(3, 1);
  grid->setColumnStretch(2, 1);
  auto* buttons = new ButtonRow(this);
  auto* close = buttons->Add("Command2", "C&lose", [this] { reject(); });
  close->setAutoDefault(false);
  close->setDefault(false);
  grid->addLayout(buttons, 4, 0, 1, 3);
}

void Adjust::Fill() {
  const std::string path = NameFilePath(services_.adjust.dataPath);
  const std::string code = names_.empty() ? std::string() : Code();
  stamp_ = services_.adjust.files.Stamp(path);
  const NameFile file(services_.adjust.files, path);
  names_ = file.ReadAll();
  std::erase_if(names_,
                [](const NameRec& rec) { return rec.RecType != kShare && rec.RecType != kIndex; });
  for (QRadioButton* option : options_) option->setEnabled(!names_.empty());
  size_t place = 0;
  for (size_t i = 0; i < names_.size(); ++i)
    if (Trim(names_[i].Code.trimmed()) == code) place = i;
  if (names_.empty()) {
    text7_->clear();
    text8_->clear();
  } else {
    Show(place);
  }
  if (!menusOff_ && services_.disableMenus) services_.disableMenus();
  menusOff_ = true;
}

std::string Adjust::Code() const { return std::string(Trim(names_[place_].Code.trimmed())); }

void Adjust::Show(size_t place) {
  place_ = place;
  const NameRec& rec = names_[place_];
  const QString code = ToQt(FromAnsi(Code()));
  const bool changed = text7_->text() != code;
  text7_->setText(code);
  text8_->setText(ToQt(FromAnsi(Trim(rec.Name.trimmed()))));
  services_.current.CurrentCode = Code();
  services_.current.PriceFileName = services_.adjust.dataPath + Code() + ".WDT";
  if (changed)
    if (auto* figures = dynamic_cast<FigureForm*>(open_.data())) figures->SecurityChanged();
}

void Adjust::Step(int by) {
  if (names_.empty()) return;
  const auto count = std::ptrdiff_t(names_.size());
  Show(size_t((std::ptrdiff_t(place_) + by + count) % count));
}

// The form of one kind takes the place of the one that is open.
void Adjust::OpenKind(int option) {
  if (open_) {
    open_->disconnect(this);
    delete open_.data();
  }
  const FigureFormServices services{.adjust = services_.adjust,
                                    .code = [this] { return Code(); },
                                    .adjusted = services_.adjusted};
  switch (option) {
    case 0: open_ = new AdjustB(services, this); break;
    case 1: open_ = new AdjustC(services, this); break;
    case 2: open_ = new AdjustSS(services, this); break;
    case 3: open_ = new AdjustCC(services, this); break;
    case 4: open_ = new AdjustD(services, this); break;
    default: open_ = new AdjustR(services, this); break;
  }
  open_->setAttribute(Qt::WA_DeleteOnClose);
  open_->show();
  StandBeside(open_, this);
}

// Coming back to the form, it takes what another program did to the name file.
bool Adjust::event(QEvent* event) {
  if (event->type() == QEvent::WindowActivate && menusOff_)
    TellErrors(services_.adjust.dialogs, kTitle, [this] {
      const auto& adjust = services_.adjust;
      if (adjust.files.Stamp(NameFilePath(adjust.dataPath)) != stamp_) Fill();
    });
  return QDialog::event(event);
}

void Adjust::done(int result) {
  delete open_.data();
  if (std::exchange(menusOff_, false) && services_.enableMenus) services_.enableMenus();
  QDialog::done(result);
}

}  // namespace kora
