#include "scans/forms/scan_form.h"

#include <QCheckBox>
#include <QGridLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPointer>
#include <QPushButton>
#include <new>

#include "base/runtime_error.h"
#include "platform/dialogs.h"
#include "platform/qt/form_parts.h"
#include "platform/qt/to_qt.h"

namespace kora {
namespace {

constexpr int kRefreshMs = 100;
constexpr int kMostTyped = 20;

}  // namespace

ScanForm::ScanForm(ScanFormServices services, QWidget* parent)
    : QDialog(parent), services_(std::move(services)) {
  setWindowFlag(Qt::WindowMinMaxButtonsHint);
}

ScanForm::~ScanForm() { ForgetBoxes(this); }

QLineEdit* ScanForm::NewText(const QString& name, const QString& about, const std::string& text,
                             int columns) {
  QLineEdit* field = NewField(this, name, columns, kMostTyped);
  field->setText(ToQt(text));
  field->setAccessibleName(about);
  field->setEnabled(false);
  return field;
}

// From each box to its fields, whatever was made first.
void ScanForm::AddToTabOrder(QWidget* widget) {
  if (lastInTabOrder_) setTabOrder(lastInTabOrder_, widget);
  lastInTabOrder_ = widget;
}

QCheckBox* ScanForm::AddCheck(QGridLayout* grid, int row, const QString& name,
                              const QString& caption, bool ticked,
                              std::initializer_list<QWidget*> fields) {
  auto* check = new QCheckBox(caption, this);
  check->setObjectName(name);
  check->setAccessibleName(QString(caption).remove('&').trimmed());
  grid->addWidget(check, row, 0);
  AddToTabOrder(check);
  int column = 1;
  for (QWidget* field : fields) {
    if (field->focusPolicy() & Qt::TabFocus) AddToTabOrder(field);
    grid->addWidget(field, row, column++, Qt::AlignLeft);
    connect(check, &QCheckBox::toggled, field, &QWidget::setEnabled);
    field->setEnabled(ticked);
  }
  check->setChecked(ticked);
  return check;
}

void ScanForm::LayOut(QWidget* criteria, const char* gridName, std::vector<GridColumn> columns,
                      const std::string& widthsKey, GridSource& rows) {
  GridServices gridServices{.dialogs = services_.dialogs, .files = services_.files};
  if (!widthsKey.empty()) {
    gridServices.widths = &services_.user;
    gridServices.section = kUserSection;
    gridServices.key = widthsKey;
  }
  grid_ = new Grid(rows, gridServices, std::move(columns), gridName, this);
  grid_->setAccessibleName("Securities found");
  grid_->SetWholeRows(true);
  grid_->SetZoom(services_.settings.Zoom);
  grid_->activated = [this](int row) { OpenRow(row); };
  panel_ = new WorkPanel(this);

  auto* buttons = new QHBoxLayout;
  const auto button = [&](const char* name, const char* caption, auto pressed) {
    auto* b = new QPushButton(caption, this);
    b->setObjectName(name);
    b->setAutoDefault(false);
    connect(b, &QPushButton::clicked, this, pressed);
    buttons->addWidget(b);
    return b;
  };
  command1_ = button("Command1", "&Proceed", [this] { Proceed(); });
  command3_ = button("Command3", "P&rint", [this] { PrintHits(); });
  QPushButton* copy = button("GridCopy", "Cop&y", [this] {
    if (grid_->SelectedRows().count() == 0) grid_->selectAll();
    grid_->Copy();
  });
  QPushButton* saveAs = button("GridSaveAs", "Save &As...", [this] { grid_->SaveAs(); });
  buttons->addStretch(1);
  command2_ = button("Command2", "&Close", [this] { reject(); });
  command1_->setDefault(true);
  for (QWidget* widget :
       std::initializer_list<QWidget*>{grid_, command1_, command3_, copy, saveAs, command2_})
    if (lastInTabOrder_) AddToTabOrder(widget);
  command3_->setEnabled(bool(services_.print));
  copy->setToolTip("Puts the selected rows, or all, on the clipboard");

  auto* box = new QVBoxLayout(this);
  box->setContentsMargins(6, 6, 6, 6);
  box->addWidget(criteria);
  box->addWidget(grid_, 1);
  box->addWidget(panel_);
  box->addLayout(buttons);
  panel_->Hold({criteria, command1_, command3_, copy, saveAs});
  SizeInLetters(this, 104, 36);
}

void ScanForm::RunScan(const QString& title, const std::function<void(Progress&)>& scan) {
  if (services_.scanning) {
    services_.dialogs.Message("A scan is running. Wait until it is done, or stop it.",
                              title.toStdString());
    return;
  }
  // The form may be gone, with its services, once the events of the scan were handled.
  const QPointer<ScanForm> here = this;
  struct Running {
    bool& scanning;
    std::function<void()> enableMenus;
    explicit Running(const ScanFormServices& s) : scanning(s.scanning), enableMenus(s.enableMenus) {
      scanning = true;
      if (s.disableMenus) s.disableMenus();
    }
    ~Running() {
      scanning = false;
      if (enableMenus) enableMenus();
    }
  };
  Dialogs& dialogs = services_.dialogs;
  const auto tell = [&](const char* text) { dialogs.Message(text, title.toStdString()); };
  try {
    const Running running(services_);
    dialogs.SetBusy(true);
    struct NotBusy {
      Dialogs& dialogs;
      ~NotBusy() { dialogs.SetBusy(false); }
    } const notBusy{dialogs};
    panel_->Run("Checking Data - WAIT", scan);
  } catch (const RunTimeError& e) {
    tell(e.what());
  } catch (const std::bad_alloc&) {
    tell(ErrorText(kOutOfMemory));
  }
  if (here) grid_->Refresh();
}

void ScanForm::RowAdded() {
  if (refreshed_.isValid() && refreshed_.elapsed() < kRefreshMs) return;
  grid_->Refresh();
  grid_->scrollToBottom();
  refreshed_.start();
}

void ScanForm::Tell(const ScanFault& fault) {
  services_.dialogs.Message(fault.text, fault.title);
  auto* control = findChild<QWidget*>(ToQt(fault.field));
  if (!control) return;
  if (auto* field = qobject_cast<QLineEdit*>(control))
    FocusField(field);
  else
    control->setFocus();
}

void ScanForm::TellEnd(std::string_view title, std::string text, const UnreadFiles& unread) {
  if (const std::string line = UnreadText(unread); !line.empty()) text += "\n" + line;
  services_.dialogs.Message(text, title);
}

bool ScanForm::AskStopped(std::string_view title) {
  return services_.dialogs.Ask(kStoppedQuestion, title, Buttons::kYesNo) == Answer::kYes;
}

bool ScanForm::Store(std::string_view title, const std::function<void()>& save) {
  try {
    save();
    return true;
  } catch (const RunTimeError& e) {
    services_.dialogs.Message("The list of results could not be stored: " + std::string(e.what()),
                              title);
    return false;
  }
}

ScanRun ScanForm::Scan(Progress& progress) const { return {services_.files, dataPath(), progress}; }

void ScanForm::reject() {
  if (panel_ && panel_->StopFirst()) return;
  if (Leave()) QDialog::reject();
}

}  // namespace kora
