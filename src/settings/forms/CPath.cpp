#include "settings/forms/CPath.h"

#include <QEvent>
#include <QGridLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QToolButton>

#include "base/runtime_error.h"
#include "base/text.h"
#include "platform/qt/form_parts.h"
#include "settings/forms/Locate.h"

namespace kora {
namespace {

std::string Entered(const QString& text) { return WithBackslash(Trim(text.toStdString())); }

}  // namespace

CPath::CPath(CPathServices services, QWidget* parent)
    : QDialog(parent), services_(std::move(services)) {
  setObjectName("CPath");
  setWindowTitle("Path Details");
  auto* grid = new QGridLayout(this);

  text1_ = AddField("Text1", "&Program Folder", 0, -1);
  text2_ = AddField("Text2", "Charting Data &File Folder", 1, 0);
  label10_[0] = AddLabel(0, "Second Data Folder", 2);
  text4_ = AddField("Text4", "Charting Data &Backup", 3, 1);
  label10_[1] = AddLabel(1, "Second Data Backup", 4);
  grid->setColumnStretch(1, 1);

  auto* save = new QPushButton("&SAVE", this);
  save->setObjectName("Command1");
  save->setDefault(true);
  auto* destinations = new QPushButton("Data &Destination Paths", this);
  destinations->setObjectName("Command3");
  destinations->setAutoDefault(false);
  const int service = services_.settings.download.DataService;
  destinations->setEnabled(service == 2 || service == 3);
  auto* close = new QPushButton("&Close", this);
  close->setObjectName("Command2");
  close->setAutoDefault(false);
  auto* buttons = new QHBoxLayout;
  buttons->addWidget(destinations);
  buttons->addStretch();
  buttons->addWidget(save);
  buttons->addWidget(close);
  grid->addLayout(buttons, 5, 0, 1, 3);

  connect(save, &QPushButton::clicked, this, [this] { Save(); });
  connect(close, &QPushButton::clicked, this, &QDialog::reject);
  connect(destinations, &QPushButton::clicked, this, [this] { services_.openWMPath(); });
}

QLineEdit* CPath::AddField(const char* name, const char* caption, int row, int browse) {
  auto* grid = static_cast<QGridLayout*>(layout());
  auto* label = new QLabel(caption, this);
  auto* field = new QLineEdit(this);
  field->setObjectName(name);
  field->setMinimumWidth(fontMetrics().averageCharWidth() * 45);
  field->installEventFilter(this);
  label->setBuddy(field);
  connect(field, &QLineEdit::textEdited, this, [this] { changed_ = true; });
  grid->addWidget(label, row, 0);
  grid->addWidget(field, row, 1);
  if (browse >= 0) {
    grid->addWidget(NewFolderButton(this, QString("Picture1(%1)").arg(browse),
                                    [this, browse] { OpenLocate(browse); }),
                    row, 2);
  }
  return field;
}

QLabel* CPath::AddLabel(int index, const char* caption, int row) {
  auto* grid = static_cast<QGridLayout*>(layout());
  auto* value = new QLabel(this);
  value->setObjectName(QString("Label10(%1)").arg(index));
  value->setTextFormat(Qt::PlainText);
  value->setFrameStyle(QFrame::Panel | QFrame::Sunken);
  value->setMargin(fontMetrics().height() / 6);
  grid->addWidget(new QLabel(caption, this), row, 0);
  grid->addWidget(value, row, 1);
  return value;
}

bool CPath::Fill() {
  Settings& settings = services_.settings;
  if (settings.PathsMissing) {
    const Answer answer = services_.dialogs.Ask(
        "Directory Paths are missing and must be re-entered. \n...\nSelect YES to enter paths \n"
        "Select NO  to use default paths \nSelect CANCEL to exit KORA ",
        "No Paths selected", Buttons::kYesNoCancel);
    if (answer == Answer::kCancel ||
        (answer == Answer::kNo &&
         !FindSystemDrive(services_.ini, services_.files, services_.dialogs, settings))) {
      services_.endProgram();
      return false;
    }
  } else if (!ReadSettings(services_.ini, services_.files, services_.dialogs, settings)) {
    services_.endProgram();
    return false;
  }
  const Paths& paths = settings.paths;
  text1_->setText(QString::fromStdString(paths.SystemPath));
  text2_->setText(QString::fromStdString(paths.CurrentDataPath));
  text4_->setText(QString::fromStdString(paths.ChartBackupPath));
  label10_[0]->setText(QString::fromStdString(paths.PfmDataPath));
  label10_[1]->setText(QString::fromStdString(paths.PfmBackupPath));
  changed_ = false;
  return true;
}

void CPath::ShowChartData() {
  text2_->setText(QString::fromStdString(services_.settings.paths.CurrentDataPath));
}

bool CPath::eventFilter(QObject* object, QEvent* event) {
  auto* field = qobject_cast<QLineEdit*>(object);
  if (field && event->type() == QEvent::FocusIn) {
    QPalette colours = field->palette();
    colours.setColor(QPalette::Base, Qt::blue);
    colours.setColor(QPalette::Text, Qt::white);
    field->setPalette(colours);
  } else if (field && event->type() == QEvent::FocusOut) {
    field->setPalette(QPalette());
    field->setText(QString::fromStdString(Entered(field->text())));
  }
  return QDialog::eventFilter(object, event);
}

void CPath::OpenLocate(int index) {
  const auto what = LocateFor("CPath", index, services_.settings.paths);
  QLineEdit* field = index == 0 ? text2_ : text4_;
  auto* locate = new Locate(
      services_.files, services_.dialogs, *what,
      [this, field](const std::string& folder) {
        const QString text = QString::fromStdString(folder);
        if (field->text() != text) changed_ = true;
        field->setText(text);
      },
      this);
  locate->setAttribute(Qt::WA_DeleteOnClose);
  locate->open();
}

// The folder that charts are read from and written to. False when it can't be.
bool CPath::CheckDataFolder(const std::string& folder) {
  const Files& files = services_.files;
  Dialogs& dialogs = services_.dialogs;
  const std::string title = windowTitle().toStdString();
  try {
    if (!files.IsFolder(folder)) {
      if (dialogs.Ask("Directory " + folder + " does not exist. Create this directory ?",
                      "Create Directory", Buttons::kYesNo) != Answer::kYes)
        return true;  // a drive that is not in, say
      files.MakeFolder(folder);
    }
    const std::string trial = folder + "Kora.tmp";
    files.Open(trial, OpenMode::kCreate);
    files.Remove(trial);
    return true;
  } catch (const RunTimeError& e) {
    dialogs.Message(folder + " can't be written to: " + e.what(), title);
    return false;
  }
}

bool CPath::Save() {
  Settings& settings = services_.settings;
  Paths entered = settings.paths;
  entered.SystemPath = Entered(text1_->text());
  entered.CurrentDataPath = Entered(text2_->text());
  entered.ChartBackupPath = Entered(text4_->text());
  entered.PfmDataPath = Entered(label10_[0]->text());
  entered.PfmBackupPath = Entered(label10_[1]->text());
  for (const std::string* path :
       {&entered.SystemPath, &entered.CurrentDataPath, &entered.PfmDataPath,
        &entered.ChartBackupPath, &entered.PfmBackupPath}) {
    if (!path->empty()) continue;
    services_.dialogs.Message("Directory paths must be entered", windowTitle().toStdString());
    return false;
  }
  for (const auto& [field, path] : {std::pair{text1_, &entered.SystemPath},
                                    {text2_, &entered.CurrentDataPath},
                                    {text4_, &entered.ChartBackupPath}}) {
    const std::string why = WhyNotKept(*path);
    if (why.empty()) continue;
    services_.dialogs.Message(*path + " " + why, windowTitle().toStdString());
    field->setFocus();
    field->selectAll();
    return false;
  }
  if (!CheckDataFolder(entered.CurrentDataPath)) {
    text2_->setFocus();
    text2_->selectAll();
    return false;
  }
  settings.paths = entered;
  SavePaths(services_.ini, settings);
  changed_ = false;
  accept();
  if (settings.PathsMissing) {
    settings.PathsMissing = false;
    if (!services_.readAllSettings()) {
      services_.endProgram();
      return true;
    }
  }
  services_.pathsSaved();
  return true;
}

void CPath::reject() {
  if (changed_ && services_.dialogs.Ask("Paths have changed. SAVE Changes ?", "Save Changes",
                                        Buttons::kYesNo) == Answer::kYes) {
    Save();
    return;
  }
  QDialog::reject();
}

}  // namespace kora
