#include "shell/forms/FirstStart.h"

#include <QDir>
#include <QFileDialog>
#include <QFileInfo>
#include <QGridLayout>
#include <QLabel>
#include <QLineEdit>
#include <QRadioButton>
#include <QStyle>
#include <QToolButton>

#include "base/runtime_error.h"
#include "base/text.h"
#include "base/version.h"
#include "platform/qt/form_parts.h"
#include "shell/new_home.h"

namespace kora {
namespace {

enum { kDemo, kEmpty, kFolder };
constexpr const char* kTitle = "First Start";

struct Choice {
  const char* caption;
  const char* note;
};
constexpr Choice kChoices[] = {
    {"An &invented market to look at",
     "Sixty shares and indices that there are none of, with six years of prices and three days of "
     "download files waiting."},
    {"An &empty installation",
     "Its folders and settings, without a security. What to do next is told."},
    {"A folder of &data that is there",
     "The folder with Names.dat and the price files. It is opened as it is; nothing is copied."},
};

}  // namespace

bool NeedsFirstStart(const Session& session) {
  return !session.ini.Exists() && session.ini.GetSetting("KoraPaths", "System") == kUnknown;
}

FirstStart::FirstStart(FirstStartServices services, QWidget* parent)
    : QDialog(parent), services_(std::move(services)) {
  setObjectName("FirstStart");
  setWindowTitle(ToQt(kProgramTitle));
  auto* grid = new QGridLayout(this);
  QLabel* head = NewNote(this,
                         "There is no installation yet in\n" +
                             ToQt(services_.session.files.home()) + "\n\nWhat shall it begin with?",
                         60);
  head->setObjectName("Label1");
  grid->addWidget(head, 0, 0, 1, 3);
  int row = 1;
  const int indent = style()->pixelMetric(QStyle::PM_ExclusiveIndicatorWidth) +
                     style()->pixelMetric(QStyle::PM_RadioButtonLabelSpacing);
  for (int i = 0; i < 3; ++i) {
    option1_[size_t(i)] = new QRadioButton(kChoices[i].caption, this);
    option1_[size_t(i)]->setObjectName(QString("Option1(%1)").arg(i));
    grid->addWidget(option1_[size_t(i)], row++, 0, 1, 3);
    QLabel* note = NewNote(this, kChoices[i].note, 60);
    option1_[size_t(i)]->setAccessibleDescription(note->text());
    grid->addWidget(note, row++, 1, 1, 2);
    connect(option1_[size_t(i)], &QRadioButton::toggled, this, [this] { ShowChoice(); });
  }
  grid->setColumnMinimumWidth(0, indent);
  grid->setColumnStretch(1, 1);
  text1_ = new QLineEdit(this);
  text1_->setObjectName("Text1");
  text1_->setAccessibleName("Folder of data");
  picture1_ = NewFolderButton(this, "Picture1(0)", [this] { PickFolder(); });
  picture1_->setAccessibleName("Choose the folder of data");
  grid->addWidget(text1_, row, 1);
  grid->addWidget(picture1_, row++, 2);
  AddOkCancel(this, grid, [this] { Choose(); });
  option1_[kDemo]->setChecked(true);
  option1_[kDemo]->setFocus();
  ShowChoice();
  // Left to itself a form takes two thirds of a small screen, and its sentences are cut.
  const int width = sizeHint().width();
  resize(width, grid->totalHeightForWidth(width));
}

void FirstStart::ShowChoice() {
  const bool folder = option1_[kFolder]->isChecked();
  text1_->setEnabled(folder);
  picture1_->setEnabled(folder);
}

void FirstStart::PickFolder() {
  std::optional<QString> folder;
  if (services_.pickFolder) {
    folder = services_.pickFolder();
  } else {
    const QString there = text1_->text();
    const QString chosen = QFileDialog::getExistingDirectory(
        this, "Folder of Data", QFileInfo(there).isDir() ? there : QDir::homePath());
    if (!chosen.isEmpty()) folder = chosen;
  }
  if (folder) text1_->setText(QDir::toNativeSeparators(*folder));
}

// What goes wrong is told and leaves the question standing.
void FirstStart::Choose() {
  Dialogs& dialogs = services_.session.dialogs;
  bool made = false;
  dialogs.SetBusy(true);
  try {
    made = Make();
    dialogs.SetBusy(false);
  } catch (const RunTimeError& e) {
    dialogs.SetBusy(false);
    dialogs.Message(e.what(), kTitle);
  }
  if (made) accept();
}

bool FirstStart::Make() {
  if (option1_[kDemo]->isChecked()) return services_.makeDemo();
  if (option1_[kFolder]->isChecked()) return OpenFolder();
  Session& session = services_.session;
  MakeEmptyHome(session.files, session.ini);
  session.dialogs.SetBusy(false);
  session.dialogs.Message(
      "There is an empty installation in " + session.files.home() +
          ".\n\nNext steps:\n\n"
          "1. Download / Modify Download Details says which data service you have and where its "
          "files land; Download / Update with Downloaded Data takes them in.\n\n"
          "2. Prices in text files are taken in with\n      koractl import FILE...\n\n"
          "3. File / Folder Locations opens a folder of data that is there.\n\n"
          "F1 opens the guide, which tells more.",
      kTitle);
  return true;
}

bool FirstStart::OpenFolder() {
  Session& session = services_.session;
  const QString entered = text1_->text().trimmed();
  std::string why = "A folder must be entered.";
  if (!entered.isEmpty()) {
    const QString host = QDir(entered).absolutePath();
    const std::string folder = WithBackslash(session.files.DosPath(host.toStdString()));
    why = WhyNoDataFolder(session.files, folder);
    if (why.empty()) {
      MakeHomeOver(session.files, session.ini, folder);
      return true;
    }
    if (QFileInfo::exists(host + "/Kora.ini"))
      why += "\n\nIt is an installation of its own. Start the program on it with\nkora --home " +
             host.toStdString();
  }
  session.dialogs.SetBusy(false);
  session.dialogs.Message(why, kTitle);
  text1_->setFocus();
  return false;
}

}  // namespace kora
