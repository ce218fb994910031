#include "looks/forms/ChtFonts.h"

#include <QFontDialog>
#include <QGridLayout>
#include <QLabel>
#include <QPushButton>
#include <QRadioButton>

#include "base/numbers.h"
#include "platform/qt/form_parts.h"
#include "platform/qt/modal.h"

namespace kora {
namespace {

// Points. Above them the title leaves its rows and the labels run into one another; the sizes of
// a new installation stand where none is chosen.
constexpr double kLeastPoints = 4, kMostPoints[] = {16, 10};
constexpr double kStandardTitle = 9.75, kStandardLabels = 6;

// Printers take the fonts that scale.
std::optional<FontChoice> PickFromPlatform(QWidget* over, const FontChoice& standing,
                                           bool printerFontsOnly) {
  QFont font = over->font();
  if (!standing.name.empty()) font.setFamily(ToQt(standing.name));
  if (standing.points > 0) font.setPointSizeF(standing.points);
  Modal<QFontDialog> dialog(font, over);
  if (printerFontsOnly) dialog->setOption(QFontDialog::ScalableFonts);
  if (dialog.Run() != QDialog::Accepted) return std::nullopt;
  font = dialog->selectedFont();
  return FontChoice{font.family().toStdString(), font.pointSizeF()};
}

}  // namespace

ChtFonts::ChtFonts(LookServices services, QWidget* parent, PickFont pick)
    : QDialog(parent), services_(std::move(services)), pick_(std::move(pick)) {
  if (!pick_) pick_ = PickFromPlatform;
  setObjectName("ChtFonts");
  setWindowTitle("Fonts");
  const FontSettings& fonts = services_.settings.fonts;
  choice_[0] = {fonts.Font1Name, fonts.TitleSize};
  choice_[1] = {fonts.Font2Name, fonts.Font2Points()};

  auto* grid = new QGridLayout(this);
  grid->addWidget(NewNote(this, "Selects Fonts to be used on charts, printouts and spreadsheets."),
                  0, 0, 1, 2);
  grid->addWidget(NewNote(this, "Click Select Font 1 or 2 to display list of available fonts."), 1,
                  0, 1, 2);
  QPushButton* first = nullptr;
  for (int i = 0; i < 2; ++i) {
    auto* select = new QPushButton(QString("Select Font &%1").arg(i + 1), this);
    select->setObjectName(QString("Command3(%1)").arg(i));
    label3_[i] = NewLabel(this, {});
    label3_[i]->setObjectName(QString("Label3(%1)").arg(i));
    label3_[i]->setTextFormat(Qt::PlainText);
    label3_[i]->setFrameStyle(QFrame::Panel | QFrame::Sunken);
    label3_[i]->setMargin(fontMetrics().height() / 6);
    grid->addWidget(select, i + 2, 0);
    grid->addWidget(label3_[i], i + 2, 1);
    connect(select, &QPushButton::clicked, this, [this, i] { Pick(i); });
    if (!first) first = select;
    ShowChoice(i);
  }
  grid->addWidget(NewNote(this, "List all fonts or only those supported by your printer"), 4, 0, 1,
                  2);
  auto* allFonts = new QRadioButton("&All fonts", this);
  allFonts->setObjectName("Option1(0)");
  allFonts->setChecked(true);
  printerFonts_ = new QRadioButton("&Printer fonts only", this);
  printerFonts_->setObjectName("Option1(1)");
  auto* none = new QPushButton("&None", this);
  none->setObjectName("Command4");
  none->setToolTip("Both texts in the standard face again");
  none->setAutoDefault(false);
  connect(none, &QPushButton::clicked, this, [this] { ChooseNone(); });
  auto* options = new QHBoxLayout;
  options->addWidget(allFonts);
  options->addWidget(printerFonts_);
  options->addStretch();
  options->addWidget(none);
  grid->addLayout(options, 5, 0, 1, 2);
  grid->setColumnStretch(1, 1);
  AddOkCancel(this, grid, [this] { Save(); });
  first->setFocus();
}

void ChtFonts::Pick(int index) {
  const auto chosen = pick_(this, choice_[index], printerFonts_->isChecked());
  if (!chosen) return;
  const auto refuse = [this](const std::string& text) {
    services_.dialogs.Message(text, windowTitle().toStdString());
  };
  // Title and labels have rows of a fixed height on the chart.
  if (chosen->points < kLeastPoints || chosen->points > kMostPoints[index])
    return refuse("The size of font " + Str(std::int32_t(index + 1)) + " must be between " +
                  Str(kLeastPoints) + " and " + Str(kMostPoints[index]));
  if (const std::string why = WhyNotKept(chosen->name); !why.empty())
    return refuse(chosen->name + " " + why);
  choice_[index] = *chosen;
  none_ = false;
  ShowChoice(index);
}

void ChtFonts::ChooseNone() {
  none_ = true;
  choice_[0] = {{}, kStandardTitle};
  choice_[1] = {{}, kStandardLabels};
  for (int i = 0; i < 2; ++i) ShowChoice(i);
}

// In the font itself, at the form's own size.
void ChtFonts::ShowChoice(int index) {
  const FontChoice& choice = choice_[index];
  QFont shown = font();
  if (!choice.name.empty()) shown.setFamily(ToQt(choice.name));
  label3_[index]->setFont(shown);
  label3_[index]->setText(choice.name.empty() ? QString("(none)")
                                              : ToQt(choice.name + "  " + Str(choice.points)));
}

void ChtFonts::Save() {
  if (none_) {
    SaveNoFonts(services_.ini, services_.settings, choice_[0].points, choice_[1].points);
  } else if (!SaveFonts(services_.ini, services_.settings, choice_[0], choice_[1])) {
    services_.dialogs.Message(kFontsMessage, windowTitle().toStdString());
    return;
  }
  accept();
  services_.Saved();
}

}  // namespace kora
