#include "chartwindow/forms/ChtSel.h"

#include <QCheckBox>
#include <QComboBox>
#include <QGridLayout>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QScrollBar>
#include <cmath>
#include <utility>

#include "chartwindow/forms/ChtOptions.h"
#include "lists/forms/IndClass.h"
#include "lists/forms/Search.h"
#include "platform/qt/to_qt.h"

namespace kora {
namespace {

QColor ColourOf(std::int32_t value) {
  return QColor(value & 0xFF, (value >> 8) & 0xFF, (value >> 16) & 0xFF);
}

bool Readable(const QColor& text, const QColor& ground) {
  return std::abs(qGray(text.rgb()) - qGray(ground.rgb())) >= 70;
}

}  // namespace

ChtSel::ChtSel(ChtSelServices services, QWidget* parent)
    : SelectionForm("ChtSel", "Chart Selection Menu", std::move(services), parent) {
  combo2_ = new QComboBox(this);
  combo2_->setObjectName("Combo2");
  for (const OscChoice& osc : OscChoices()) combo2_->addItem(ToQt(osc.caption));
  combo2_->setMaxVisibleItems(int(OscChoices().size()));
  combo3_ = new QComboBox(this);
  combo3_->setObjectName("Combo3");
  combo3_->addItems({"(None)", "Percentage Bands", "Bollinger Bands"});
  oAve1_ = new QCheckBox(this);
  oAve1_->setObjectName("OAve1");
  oAve2_ = new QCheckBox(this);
  oAve2_->setObjectName("OAve2");
  text6_ = AddSwitch("Text6");
  text7_ = AddSwitch("Text7");
  check16_ = new QCheckBox("&Industry Class", this);
  check16_->setObjectName("Check16");
  text8_ = AddShown("Text8", 6);
  text8_->setAccessibleName("Industry Class");
  text8_->setToolTip("Type a class or group and press ENTER; double click to choose");
  command1_ = AddButton("Command1", "Change &List");
  command6_ = AddButton("Command6", "Chan&ge Folder");
  command7_ = AddButton("Command7", "Set De&faults");

  auto* top = new QHBoxLayout;
  top->addWidget(label8_, 1);
  top->addWidget(command1_);
  top->addWidget(command6_);

  auto* averages = new QHBoxLayout;
  averages->addWidget(oAve1_);
  averages->addWidget(oAve2_);
  averages->addStretch();

  auto* grid = new QGridLayout;
  const auto put = [&](int row, int side, QWidget* caption, auto add) {
    grid->addWidget(caption, row, side * 3);
    add(row, side * 3 + 1);
  };
  const auto widget = [&](QWidget* w) {
    return [grid, w](int row, int column) { grid->addWidget(w, row, column); };
  };
  put(0, 0, AddCaption("&Type of Chart", combo1_), widget(combo1_));
  put(1, 0, AddCaption("&Period", combo4_), widget(combo4_));
  put(2, 0, label4_, widget(SpacingRow()));
  put(3, 0, AddCaption("Finish &Date", text6_), widget(text6_));
  put(0, 1, AddCaption("&Bands", combo3_), widget(combo3_));
  put(1, 1, AddCaption("&Oscillators", combo2_), widget(combo2_));
  put(2, 1, AddCaption("&Averages", oAve1_),
      [&](int row, int column) { grid->addLayout(averages, row, column); });
  put(3, 1, AddCaption("&Volumes", text7_), widget(text7_));
  put(4, 0, check16_, widget(text8_));
  grid->setColumnStretch(1, 1);
  grid->setColumnStretch(4, 1);
  grid->setColumnMinimumWidth(2, fontMetrics().averageCharWidth() * 3);

  auto* buttons = new QHBoxLayout;
  buttons->addWidget(command7_);
  buttons->addStretch();
  buttons->addWidget(ok_);
  buttons->addWidget(command2_);

  auto* rows = new QVBoxLayout(this);
  rows->addLayout(top);
  rows->addLayout(SecurityRow());
  rows->addSpacing(fontMetrics().height() / 2);
  rows->addLayout(grid);
  rows->addStretch();
  rows->addSpacing(fontMetrics().height() / 2);
  rows->addLayout(buttons);

  QWidget* order[] = {text1_,  text2_,    vScroll1_, combo1_,   combo4_,  text3_,   text6_,
                      combo3_, combo2_,   oAve1_,    oAve2_,    text7_,   check16_, text8_,
                      ok_,     command2_, command1_, command6_, command7_};
  for (size_t i = 1; i < std::size(order); ++i) setTabOrder(order[i - 1], order[i]);

  connect(combo2_, &QComboBox::activated, this, [this](int index) {
    services_.selection.ChooseOscillator(index);
    Refresh();
  });
  connect(combo3_, &QComboBox::activated, this, [this](int index) {
    const bool ask = services_.selection.ChooseBands(index);
    Refresh();
    if (ask && services_.openChtBands) services_.openChtBands();
  });
  connect(oAve1_, &QCheckBox::clicked, this, [this](bool ticked) {
    services_.selection.TickAverage(1, ticked);
    Refresh();
  });
  connect(oAve2_, &QCheckBox::clicked, this, [this](bool ticked) {
    services_.selection.TickAverage(2, ticked);
    Refresh();
  });
  connect(check16_, &QCheckBox::clicked, this, [this](bool ticked) {
    if (ticked) {
      OpenIndClass();
      return;
    }
    services_.selection.ClearIndustry();
    Refresh();
  });
  connect(command1_, &QPushButton::clicked, this, [this] { OpenChtOptions(); });
  connect(command6_, &QPushButton::clicked, this, [this] {
    if (!services_.openWMPath()) return;
    services_.selection.FolderChanged();
    services_.selection.Load();
    Refresh();
    FocusCode();
  });
  connect(command7_, &QPushButton::clicked, this, [this] {
    services_.state.ChartTask = kTaskSelectionDefaults;
    services_.openChtDef([this] {
      services_.selection.AveragesChanged();
      Refresh();
    });
  });

  services_.selection.Load();
  Refresh();
}

// A field that a click or ENTER changes.
QLineEdit* ChtSel::AddSwitch(const char* name) {
  QLineEdit* field = AddShown(name, 12);
  field->setReadOnly(true);
  return field;
}

// An average shows as on the chart: in its colour, on the chart's background. Unticked, its
// colour is held to what can be read on the form.
void ChtSel::ColourAverage(QCheckBox* box, bool onGround, int entry) {
  QPalette palette;
  QColor text = ColourOf(services_.colours[size_t(entry)]);
  const QColor ground =
      onGround ? ColourOf(services_.colours[kBackground]) : palette.color(QPalette::Window);
  if (!Readable(text, ground)) text = palette.color(QPalette::WindowText);
  if (onGround) palette.setColor(box->backgroundRole(), ground);
  palette.setColor(QPalette::Active, QPalette::WindowText, text);
  palette.setColor(QPalette::Inactive, QPalette::WindowText, text);
  box->setAutoFillBackground(onGround);
  box->setPalette(palette);
}

void ChtSel::Refresh() {
  SelectionForm::Refresh();
  const ChartSelectionView& view = services_.selection.view();
  combo2_->setCurrentIndex(view.Combo2);
  combo3_->setCurrentIndex(view.Combo3);
  oAve1_->setText(QString::fromStdString(view.OAve1));
  oAve2_->setText(QString::fromStdString(view.OAve2));
  oAve1_->setChecked(view.OAve1Ticked);
  oAve2_->setChecked(view.OAve2Ticked);
  ColourAverage(oAve1_, view.ExtrasEnabled && view.OAve1Ticked, view.OAve1Colour);
  ColourAverage(oAve2_, view.ExtrasEnabled && view.OAve2Ticked, view.OAve2Colour);
  for (QWidget* extra : std::initializer_list<QWidget*>{combo2_, combo3_, oAve1_, oAve2_})
    extra->setEnabled(view.ExtrasEnabled);
  text6_->setText(QString::fromStdString(view.Text6));
  text6_->setEnabled(bool(services_.openFinDate));
  text7_->setText(QString::fromStdString(view.Text7));
  check16_->setChecked(view.Check16);
  text8_->setText(QString::fromStdString(view.Text8));
  check16_->setEnabled(view.IndustryEnabled);
  text8_->setEnabled(view.IndustryEnabled);
  command6_->setVisible(view.Command6Shown);
  command6_->setEnabled(view.Command6Shown && services_.openWMPath);
  command7_->setEnabled(bool(services_.openChtDef));
}

void ChtSel::Leave() {
  services_.selection.Close();
  const auto closed = services_.closed;
  QDialog::reject();
  if (closed) closed();
}

// Back to the chart that stands, as if the form had not been opened.
void ChtSel::Escape() {
  const auto back = services_.backToChart;
  if (!back || !back()) return reject();
  QDialog::reject();
}

bool ChtSel::event(QEvent* event) {
  const bool taken = SelectionForm::event(event);
  if (event->type() == QEvent::WindowActivate) Activated();
  // The averages stand on the colours of the desktop.
  if (event->type() == QEvent::ApplicationPaletteChange) Refresh();
  return taken;
}

void ChtSel::Activated() {
  if (!services_.selection.Activate()) return;
  Refresh();
  FocusCode();
}

void ChtSel::OpenChtOptions() {
  auto* options = new ChtOptions({.selection = services_.selection,
                                  .files = services_.files,
                                  .settings = services_.settings,
                                  .user = services_.user,
                                  .chartListNo = services_.state.ChartListNo},
                                 this);
  options->setAttribute(Qt::WA_DeleteOnClose);
  connect(options, &QDialog::accepted, this, [this] { Activated(); });
  options->open();
}

void ChtSel::OpenSearch() {
  if (!services_.selection.MaySearchByName(text2_->text().toStdString())) return;
  auto* search =
      new Search(services_.files, services_.dialogs, services_.settings.paths.CurrentDataPath,
                 text2_->text().trimmed().toStdString(), this);
  search->setAttribute(Qt::WA_DeleteOnClose);
  connect(search, &QDialog::accepted, this, [this, search] {
    services_.selection.TakeSearch(search->match() ? std::optional(search->match()->record)
                                                   : std::nullopt);
    Refresh();
  });
  search->open();
}

void ChtSel::OpenIndClass() {
  services_.dialogs.SetBusy(true);
  const QString typed = text8_->text();
  services_.selection.StartIndustryPicker();
  check16_->setChecked(true);
  auto* picker =
      new IndClass(services_.files, services_.dialogs, services_.settings.paths.SystemPath, this);
  picker->Select(typed.trimmed().toStdString());
  picker->setAttribute(Qt::WA_DeleteOnClose);
  connect(picker, &QDialog::finished, this, [this, picker, typed](int result) {
    services_.selection.EnterIndustry(
        result == QDialog::Accepted ? picker->chosen() : typed.toStdString(), true);
    Refresh();
  });
  services_.dialogs.SetBusy(false);
  picker->open();
}

void ChtSel::ClickFinishDate() {
  const QPointer<ChtSel> there(this);
  services_.selection.ClickFinishDate(services_.openFinDate);
  if (there) Refresh();
}

bool ChtSel::FieldEnter(QObject* field) {
  if (field == text2_) {
    OpenSearch();
    return true;
  }
  if (field == text6_) {
    ClickFinishDate();
    return true;
  }
  if (field == text7_) {
    services_.selection.FlipVolumes();
    Refresh();
    return true;
  }
  if (field == text8_) {
    services_.selection.EnterIndustry(text8_->text().toStdString(), false);
    Refresh();
    return true;
  }
  return SelectionForm::FieldEnter(field);
}

bool ChtSel::FieldMouse(QObject* field, QEvent::Type type) {
  // The release that ends a double click is no click of its own.
  if (type == QEvent::MouseButtonRelease && std::exchange(doubleClicked_, false)) return true;
  if (type == QEvent::MouseButtonDblClick) doubleClicked_ = true;
  if (type == QEvent::MouseButtonRelease && static_cast<QWidget*>(field)->isEnabled()) {
    if (field == text6_)
      ClickFinishDate();
    else if (field == text7_)
      FieldEnter(text7_);
  }
  if (type == QEvent::MouseButtonDblClick) {
    if (field == text6_) {
      services_.selection.LatestDate();
      Refresh();
      return true;
    }
    if (field == text8_ && text8_->isEnabled()) {
      OpenIndClass();
      return true;
    }
  }
  return false;
}

}  // namespace kora
