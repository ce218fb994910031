#include "indicators/forms/ChtDef.h"

#include <QCheckBox>
#include <QGridLayout>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>

#include "platform/qt/form_parts.h"

namespace kora {
namespace {

constexpr size_t kColumns = 2;  // of periods
constexpr int kLongestPeriod = 32767;

}  // namespace

// One of two words, changed by a click, Space or Enter.
class ToggleBox : public QPushButton {
 public:
  ToggleBox(QWidget* parent, const char* name, const char* on, const char* off)
      : QPushButton(parent), on_(on), off_(off) {
    setObjectName(name);
    // As wide as the longer word, so that the form keeps still.
    setText(on_.size() > off_.size() ? on_ : off_);
    setMinimumWidth(sizeHint().width());
    Set(false);
    connect(this, &QPushButton::clicked, this, [this] { Set(!value_); });
  }
  bool value() const { return value_; }
  void Set(bool value) {
    value_ = value;
    setText(value ? on_ : off_);
    if (!what_.isEmpty()) setAccessibleName(what_ + ": " + text());
  }
  // What the words are about, for those who can't see the label.
  void Call(const QString& what) {
    what_ = what.simplified();
    Set(value_);
  }

 private:
  QString what_;
  QString on_, off_;
  bool value_ = false;
};

ChtDef::ChtDef(ChtDefServices services, QWidget* parent)
    : QDialog(parent), services_(std::move(services)) {
  setObjectName("ChtDef");
  setWindowTitle("Chart Defaults");
  // Three columns on one grid, so that their rows stand level.
  auto* grid = new QGridLayout;
  AddPeriods(grid);
  AddSwitches(grid);
  for (const int gap : {3, 7}) grid->setColumnMinimumWidth(gap, fontMetrics().height());
  grid->setColumnStretch(12, 1);

  auto* compare = new QHBoxLayout;
  compFile_ = NewField(this, "CompFile", 40, 100);
  compare->addWidget(NewLabel(this, "RMO/RMX compare (&path and file)", compFile_));
  compare->addWidget(compFile_, 1);

  auto* layout = new QVBoxLayout(this);
  layout->addLayout(grid);
  layout->addLayout(compare);
  layout->addStretch();
  auto* buttons = new ButtonRow(this);
  buttons->Add("Command1", "&SAVE", [this] { Save(); });
  buttons->Add("Command2", "&Close", [this] { reject(); });
  buttons->Add("Command3", "Change Sca&les", [this] { OpenScales(); })
      ->setEnabled(bool(services_.openScales));
  saved_ = NewLabel(this, {});
  saved_->setObjectName("Saved");
  buttons->insertWidget(0, saved_);
  layout->addLayout(buttons);
  for (QLineEdit* field : findChildren<QLineEdit*>())
    connect(field, &QLineEdit::textEdited, saved_, &QLabel::clear);
  for (QAbstractButton* box : findChildren<QAbstractButton*>())
    if (box->objectName() != "Command1")
      connect(box, &QAbstractButton::clicked, saved_, &QLabel::clear);

  connect(avOne_, &QPushButton::clicked, this, [this] { AverageSwitched(); });
  connect(avTwo_, &QPushButton::clicked, this, [this] { AverageSwitched(); });
  scMethod_->installEventFilter(this);
  if (services_.readSettings) services_.readSettings();
  Fill(DefaultsFromSettings(services_.settings));
  FocusField(periods_[0].first);
}

ChtDef::Twin ChtDef::AddTwin(QGridLayout* grid, int row, int column, const char* caption,
                             const char* daily, const char* twin) {
  const Twin fields{NewField(this, daily, 4, 6), NewField(this, twin, 4, 6)};
  fields.first->setAccessibleName(QString(caption) + " daily");
  fields.second->setAccessibleName(QString(caption) + " weekly");
  grid->addWidget(NewLabel(this, caption, fields.first), row, column);
  grid->addWidget(fields.first, row, column + 1);
  grid->addWidget(fields.second, row, column + 2);
  return fields;
}

void ChtDef::AddHeads(QGridLayout* grid, int column) {
  grid->addWidget(NewLabel(this, "Daily"), 0, column + 1);
  grid->addWidget(NewLabel(this, "Weekly"), 0, column + 2);
}

void ChtDef::AddPeriods(QGridLayout* grid) {
  const std::span<const OscKey> keys = OscKeys();
  const size_t rows = (keys.size() + kColumns - 1) / kColumns;
  for (size_t i = 0; i < keys.size(); ++i) {
    const int column = int(i / rows) * 4, row = int(i % rows);
    if (row == 0) AddHeads(grid, column);
    periods_.push_back(
        AddTwin(grid, 1 + row, column, keys[i].caption, keys[i].daily, keys[i].twin));
  }
}

void ChtDef::AddSwitches(QGridLayout* grid) {
  constexpr int kColumn = 8;
  AddHeads(grid, kColumn);
  const auto average = [&](int row, const char* caption, const char* name) {
    auto* box = new ToggleBox(this, name, "ON", "OFF");
    box->Call(caption);
    grid->addWidget(box, row, kColumn + 3);
    return box;
  };
  average1_ = AddTwin(grid, 1, kColumn, "Average 1", "Av1D", "Av1W");
  avOne_ = average(1, "Average 1", "AvOne");
  average2_ = AddTwin(grid, 2, kColumn, "Average 2", "Av2D", "Av2W");
  avTwo_ = average(2, "Average 2", "AvTwo");

  int row = 3;
  const auto toggle = [&](const char* caption, const char* name, const char* on, const char* off) {
    auto* box = new ToggleBox(this, name, on, off);
    box->Call(caption);
    grid->addWidget(NewLabel(this, caption, box), row, kColumn);
    grid->addWidget(box, row++, kColumn + 1, 1, 2);
    return box;
  };
  avCalc_ = toggle("Averages", "AvCalc", "Exponential", "Simple Moving");
  scMethod_ = toggle("Scales", "ScMethod", "Automatic", "Name File");
  bars_ = toggle("Bar Charts and   Candlestick Charts", "BCCalTp", "Logarithmic", "Arithmetic");
  lines_ = toggle("Line Charts", "LCalTp", "Logarithmic", "Arithmetic");
  volumes_ = toggle("Volumes", "VCalTp", "Logarithmic", "Arithmetic");
  cutVols_ = toggle("Volumes Height", "CutVols", "Limit Height", "Full Height");
  showOsc_ = toggle("Always show oscillator settings box ", "ShowOsc", "ON", "OFF");
  const auto check = [&](const char* caption, const char* name) {
    auto* box = new QCheckBox(caption, this);
    box->setObjectName(name);
    grid->addWidget(box, row++, kColumn, 1, 4);
    return box;
  };
  fxRev_ = check("&FX reversed in R/F Oscillator", "FXRev");
  fillIn_ = check("Fill &In Directional Movement Osc.", "FillIn");
  rfAve_ = check("Show &averages in R/F oscillator", "RFAve");
}

// Any letter changes the scale method, as a click does.
bool ChtDef::eventFilter(QObject* object, QEvent* event) {
  if (object == scMethod_ && event->type() == QEvent::KeyPress) {
    const auto* key = static_cast<QKeyEvent*>(event);
    const bool command = key->modifiers() & (Qt::ControlModifier | Qt::AltModifier);
    if (!command && !key->text().isEmpty() && key->text()[0].isPrint()) {
      scMethod_->Set(!scMethod_->value());
      return true;
    }
  }
  return QDialog::eventFilter(object, event);
}

void ChtDef::Fill(const ChartDefaults& form) {
  const auto twin = [](const Twin& fields, const ChartDefaults::Twin& texts) {
    fields.first->setText(ToQt(texts.daily));
    fields.second->setText(ToQt(texts.twin));
  };
  for (size_t i = 0; i < periods_.size(); ++i) twin(periods_[i], form.periods[i]);
  twin(average1_, form.average1);
  twin(average2_, form.average2);
  compFile_->setText(ToQt(form.CompFile));
  avOne_->Set(form.AvOne);
  avTwo_->Set(form.AvTwo);
  avCalc_->Set(form.AvCalc);
  scMethod_->Set(form.ScMethod);
  bars_->Set(form.BCCalTp);
  lines_->Set(form.LCalTp);
  volumes_->Set(form.VCalTp);
  cutVols_->Set(form.CutVols);
  showOsc_->Set(form.ShowOsc);
  fxRev_->setChecked(form.FXReversed);
  fillIn_->setChecked(form.FillIn);
  rfAve_->setChecked(form.RFAve);
}

ChartDefaults ChtDef::Typed() const {
  const auto twin = [](const Twin& fields) {
    return ChartDefaults::Twin{fields.first->text().toStdString(),
                               fields.second->text().toStdString()};
  };
  ChartDefaults form;
  for (const Twin& fields : periods_) form.periods.push_back(twin(fields));
  form.average1 = twin(average1_);
  form.average2 = twin(average2_);
  form.CompFile = compFile_->text().toStdString();
  form.AvOne = avOne_->value();
  form.AvTwo = avTwo_->value();
  form.AvCalc = avCalc_->value();
  form.ScMethod = scMethod_->value();
  form.BCCalTp = bars_->value();
  form.LCalTp = lines_->value();
  form.VCalTp = volumes_->value();
  form.CutVols = cutVols_->value();
  form.ShowOsc = showOsc_->value();
  form.FXReversed = fxRev_->isChecked();
  form.FillIn = fillIn_->isChecked();
  form.RFAve = rfAve_->isChecked();
  return form;
}

QLineEdit* ChtDef::FirstFault() const {
  std::vector<Twin> all = periods_;
  all.insert(all.end(), {average1_, average2_});
  for (const Twin& fields : all)
    for (QLineEdit* field : {fields.first, fields.second}) {
      bool whole = false;
      const int value = field->text().trimmed().toInt(&whole);
      if (!whole || value < 0 || value > kLongestPeriod) return field;
    }
  return nullptr;
}

void ChtDef::Save() {
  saved_->clear();
  if (QLineEdit* fault = FirstFault()) {
    services_.dialogs.Message("Value must be between 0 and " + std::to_string(kLongestPeriod),
                              windowTitle().toStdString());
    FocusField(fault);
    return;
  }
  const DefaultsSaved saved = SaveChartDefaults(services_.ini, services_.files, services_.dialogs,
                                                Typed(), services_.settings);
  if (saved == DefaultsSaved::kCompareFile) {
    FocusField(compFile_);
    return;
  }
  // As it was kept: a text that was no number is 0 now.
  Fill(DefaultsFromSettings(services_.settings));
  if (services_.averagesChanged) services_.averagesChanged();
  saved_->setText("Saved");
}

// Takes effect before a save.
void ChtDef::AverageSwitched() {
  services_.settings.charts.AvOne = avOne_->value();
  services_.settings.charts.AvTwo = avTwo_->value();
  if (services_.averagesChanged) services_.averagesChanged();
}

void ChtDef::OpenScales() {
  if (!scMethod_->value()) services_.openScales();
}

void ChtDef::reject() {
  QDialog::reject();
  if (services_.opener == ChtDefOpener::kChartWindow && services_.refreshChart)
    services_.refreshChart();
}

}  // namespace kora
