#include "looks/forms/ColNew.h"

#include <QAbstractButton>
#include <QButtonGroup>
#include <QGridLayout>
#include <QLabel>
#include <QPainter>
#include <QPushButton>
#include <QStyleOption>
#include <algorithm>
#include <cmath>

#include "base/runtime_error.h"
#include "looks/look_settings.h"
#include "platform/qt/form_parts.h"

namespace kora {
namespace {

constexpr const char* kTitle = "Change Chart Colours";

// Names of the standard colours, for those who can't see them.
constexpr const char* kColourNames[] = {
    "black",     "blue",          "green",        "cyan",        "red",         "magenta",
    "yellow",    "white",         "grey",         "light blue",  "light green", "light cyan",
    "light red", "light magenta", "light yellow", "bright white"};

QColor ColourOf(std::int32_t value) {
  return QColor(value & 0xFF, (value >> 8) & 0xFF, (value >> 16) & 0xFF);
}

// How far two colours stand apart for the eye, 1 to 21.
double Contrast(const QColor& a, const QColor& b) {
  const auto light = [](const QColor& c) {
    const auto part = [](double v) {
      return v <= 0.03928 ? v / 12.92 : std::pow((v + 0.055) / 1.055, 2.4);
    };
    return 0.2126 * part(c.redF()) + 0.7152 * part(c.greenF()) + 0.0722 * part(c.blueF());
  };
  const double x = light(a), y = light(b);
  return (std::max(x, y) + 0.05) / (std::min(x, y) + 0.05);
}

constexpr double kReadable = 3;  // contrast of a text

// Black or white, whichever can be read on `back`.
QColor ReadableOn(const QColor& back) { return qGray(back.rgb()) < 128 ? Qt::white : Qt::black; }

}  // namespace

// A text, or none, in a colour on a colour; a button to the mouse and the keyboard.
class ColourItem : public QAbstractButton {
 public:
  explicit ColourItem(QWidget* parent) : QAbstractButton(parent) {
    setFocusPolicy(Qt::StrongFocus);
  }
  void SetColours(const QColor& text, const QColor& back) {
    text_ = text;
    back_ = back;
    update();
  }
  QSize sizeHint() const override {
    const QFontMetrics metrics = fontMetrics();
    const int space = metrics.height() / 2;
    const int width = text().isEmpty() ? metrics.height() : metrics.horizontalAdvance(text());
    return {width + 3 * space, metrics.height() + space};
  }
  QSize minimumSizeHint() const override { return sizeHint(); }

 protected:
  void paintEvent(QPaintEvent*) override {
    QPainter painter(this);
    painter.fillRect(rect(), back_);
    painter.setPen(palette().color(QPalette::Mid));
    painter.drawRect(rect().adjusted(0, 0, -1, -1));
    // The item's colour stands beside its name, which stays readable whatever that colour is.
    const int side = text().isEmpty() ? 0 : fontMetrics().height() / 2;
    if (side > 0) painter.fillRect(side / 2, (height() - side) / 2, side, side, text_);
    painter.setPen(Contrast(text_, back_) >= kReadable ? text_ : ReadableOn(back_));
    painter.drawText(rect().adjusted(side, 0, 0, 0), Qt::AlignCenter, text());
    if (isChecked()) {
      QPen pen(ReadableOn(back_), 2);
      painter.setPen(pen);
      painter.drawRect(rect().adjusted(3, 3, -4, -4));
    }
    if (!hasFocus()) return;
    painter.setPen(QPen(ReadableOn(back_), 1, Qt::DotLine));
    painter.drawRect(rect().adjusted(1, 1, -2, -2));
  }

 private:
  QColor text_, back_;
};

int ColNew::EntryOf(int index) {
  if (index == 0) return kBackground;
  return index == 1 ? int(kBorder) : kBorder + index;
}

ColNew::ColNew(ColNewServices services, QWidget* parent)
    : QDialog(parent), services_(std::move(services)) {
  setObjectName("ColNew");
  setWindowTitle(kTitle);
  auto* layout = new QVBoxLayout(this);
  layout->addWidget(
      NewNote(this, "Click colour then click items that you want to change to that colour", 70));

  auto* swatches = new QGridLayout;
  swatches->setSpacing(2);
  auto* swatchGroup = new QButtonGroup(this);
  for (int i = 0; i < kSwatches; ++i) {
    label1_[i] = new ColourItem(this);
    label1_[i]->setObjectName(QString("Label1(%1)").arg(i));
    label1_[i]->setAccessibleName(kColourNames[i]);
    label1_[i]->setToolTip(kColourNames[i]);
    label1_[i]->setCheckable(true);
    swatchGroup->addButton(label1_[i], i);
    swatches->addWidget(label1_[i], i / 8, i % 8);
  }
  connect(swatchGroup, &QButtonGroup::idToggled, this, [this](int id, bool on) {
    if (on) chosen_ = id;
  });
  label1_[chosen_]->setChecked(true);
  layout->addLayout(swatches);

  auto* items = new QGridLayout;
  items->setSpacing(2);
  auto* itemGroup = new QButtonGroup(this);
  itemGroup->setExclusive(false);
  for (int i = 0; i < kItems; ++i) {
    label2_[i] = new ColourItem(this);
    label2_[i]->setObjectName(QString("Label2(%1)").arg(i));
    label2_[i]->setText(ToQt(ColourRoleName(EntryOf(i))));
    // For an item in the colour of the background.
    label2_[i]->setToolTip(label2_[i]->text());
    // Entries beyond the roles colour nothing.
    label2_[i]->setEnabled(!label2_[i]->text().isEmpty());
    itemGroup->addButton(label2_[i], i);
    items->addWidget(label2_[i], i % 7, i / 7);
  }
  connect(itemGroup, &QButtonGroup::idClicked, this, [this](int id) { Give(id); });
  layout->addLayout(items);
  layout->addStretch();

  auto* buttons = new ButtonRow(this);
  buttons->Add("Command1", "&Save Colours", [this] { Save(); });
  const std::pair<const char*, const char*> variants[] = {
      {"Default B&LACK", "Black"}, {"Default &WHITE", "White"}, {"Default &BLUE", "Blue"}};
  for (int i = 0; i < 3; ++i)
    buttons->Add(QString("Command2(%1)").arg(i), variants[i].first,
                 [this, variant = variants[i].second] { LoadVariant(variant); });
  buttons->Add("Command3", "E&xit without Saving", [this] { reject(); });
  layout->addLayout(buttons);
  ShowColours();
  label1_[0]->setFocus();
}

void ColNew::Give(int index) {
  services_.colours[size_t(EntryOf(index))] = StandardColours()[size_t(chosen_)];
  ShowColours();
}

void ColNew::ShowColours() {
  for (int i = 0; i < kSwatches; ++i) {
    const QColor colour = ColourOf(StandardColours()[size_t(i)]);
    label1_[i]->SetColours(colour, colour);
  }
  const QColor back = ColourOf(services_.colours[kBackground]);
  for (int i = 0; i < kItems; ++i) {
    const QColor own = ColourOf(services_.colours[size_t(EntryOf(i))]);
    label2_[i]->SetColours(i == 0 ? ReadableOn(back) : own, back);
  }
}

void ColNew::LoadVariant(const char* variant) {
  LoadColours(services_.files, services_.systemPath, variant, services_.colours);
  ShowColours();
}

void ColNew::Save() {
  try {
    SaveColours(services_.files, services_.systemPath, services_.colours);
  } catch (const RunTimeError&) {
    services_.dialogs.Message(kNotSavedMessage, kNotSavedTitle);
    return;
  }
  accept();
  Left();
}

void ColNew::reject() {
  LoadUserColours(services_.files, services_.systemPath, services_.colours);
  QDialog::reject();
  Left();
}

void ColNew::Left() {
  if (services_.closed) services_.closed();
}

}  // namespace kora
