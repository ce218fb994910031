#include "tests/print_queue/cups_queue.h"

#include <signal.h>
#include <sys/prctl.h>
#include <unistd.h>

#include <QCoreApplication>
#include <QDir>
#include <QFile>
#include <QRegularExpression>
#include <QStandardPaths>
#include <QTest>

namespace kora::test {
namespace {

constexpr const char* kBackend = "/usr/lib/cups/backend/cups-pdf";
constexpr const char* kModel = "/usr/share/ppd/cups-pdf/CUPS-PDF_opt.ppd";
// Where the queue leaves what a user unknown to the machine prints.
constexpr const char* kMade = "/var/spool/cups-pdf/ANONYMOUS";
constexpr int kLongest = 60000;  // ms, of anything that is waited for

QString Program(const QString& name) {
  const QString found = QStandardPaths::findExecutable(name);
  return found.isEmpty() ? QStandardPaths::findExecutable(name, {"/usr/sbin", "/sbin"}) : found;
}

bool Put(const QString& path, const QByteArray& text) {
  QFile file(path);
  return file.open(QIODevice::WriteOnly) && file.write(text) == text.size();
}

}  // namespace

QString CupsQueue::Missing() {
  if (geteuid() != 0) return "the rights to run a CUPS";
  for (const char* program : {"cupsd", "lpadmin", "lpstat", "gs"})
    if (Program(program).isEmpty()) return QString(program) + " (packages cups, ghostscript)";
  for (const char* file : {kBackend, kModel})
    if (!QFile::exists(file)) return QString(file) + " (package printer-driver-cups-pdf)";
  return {};
}

CupsQueue::CupsQueue() {
  if (!folder_.isValid()) return;
  const QString root = folder_.path();
  // CUPS runs its filters as a user of their own.
  const auto all = QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner | QFile::ReadGroup |
                   QFile::ExeGroup | QFile::ReadOther | QFile::ExeOther;
  QFile::setPermissions(root, all);
  for (const char* folder : {"server", "spool", "cache", "state", "tmp"})
    if (!QDir(root).mkdir(folder)) return;
  QFile::setPermissions(root + "/tmp", all | QFile::WriteGroup | QFile::WriteOther);
  const QString socket = root + "/socket";
  // Documents are numbered from the process on, so that those of tests that run at the same time
  // have different files.
  const qint64 first = QCoreApplication::applicationPid() % 200000 * 1000 + 1;
  if (!Put(root + "/cache/job.cache", "NextJobId " + QByteArray::number(first) + "\n") ||
      !Put(root + "/server/cupsd.conf",
           "Listen " + socket.toUtf8() +
               "\nLogLevel info\nWebInterface No\nBrowsing No\nDefaultAuthType None\n"
               "<Location />\n  Allow all\n</Location>\n"
               "<Policy default>\n  <Limit All>\n    Order allow,deny\n    Allow all\n"
               "  </Limit>\n</Policy>\n") ||
      !Put(root + "/server/cups-files.conf",
           QString("ServerRoot %1/server\nRequestRoot %1/spool\nCacheDir %1/cache\n"
                   "StateDir %1/state\nTempDir %1/tmp\nErrorLog %1/error_log\n"
                   "AccessLog %1/access_log\nPageLog %1/page_log\n")
               .arg(root)
               .toUtf8()))
    return;
  daemon_.setProcessChannelMode(QProcess::MergedChannels);
  // A test that crashes takes its daemon with it.
  daemon_.setChildProcessModifier([] { prctl(PR_SET_PDEATHSIG, SIGTERM); });
  daemon_.start(Program("cupsd"),
                {"-f", "-c", root + "/server/cupsd.conf", "-s", root + "/server/cups-files.conf"});
  if (!daemon_.waitForStarted(kLongest)) return;
  qputenv("CUPS_SERVER", socket.toUtf8());
  qputenv("CUPS_USER", "kora-tests");
  const bool answers = QTest::qWaitFor(
      [&] {
        return daemon_.state() != QProcess::Running ||
               (QFile::exists(socket) && Run("lpstat", {"-r"}));
      },
      kLongest);
  works_ = answers && daemon_.state() == QProcess::Running && AddQueue();
}

CupsQueue::~CupsQueue() {
  daemon_.terminate();
  if (!daemon_.waitForFinished(10000)) {
    daemon_.kill();
    daemon_.waitForFinished(10000);
  }
}

QString CupsQueue::Log() const {
  QFile log(folder_.filePath("error_log"));
  QString text = QString::fromLocal8Bit(const_cast<QProcess&>(daemon_).readAll());
  if (log.open(QIODevice::ReadOnly)) text += QString::fromUtf8(log.readAll().right(4000));
  return text;
}

bool CupsQueue::Run(const QString& program, const QStringList& arguments) const {
  QProcess process;
  process.start(Program(program), arguments);
  return process.waitForFinished(kLongest) && process.exitStatus() == QProcess::NormalExit &&
         process.exitCode() == 0;
}

bool CupsQueue::AddQueue() const {
  return Run("lpadmin", {"-p", kName, "-E", "-v", "cups-pdf:/", "-P", kModel, "-o", "Label=2", "-o",
                         "TitlePref=1"});
}

QList<int> CupsQueue::Done() const {
  QProcess process;
  process.start(Program("lpstat"), {"-W", "completed", "-o", kName});
  QList<int> numbers;
  if (!process.waitForFinished(kLongest)) return numbers;
  static const QRegularExpression line(QString("^%1-(\\d+)").arg(kName),
                                       QRegularExpression::MultilineOption);
  auto found = line.globalMatch(QString::fromUtf8(process.readAllStandardOutput()));
  while (found.hasNext()) numbers << found.next().captured(1).toInt();
  std::sort(numbers.begin(), numbers.end());
  return numbers;
}

QByteArray CupsQueue::NextPdf(const QList<int>& before) const {
  QList<int> done;
  if (!QTest::qWaitFor([&] { return (done = Done()).size() > before.size(); }, kLongest)) return {};
  const QString files = QString("*job_%1*").arg(done.last());
  QByteArray pdf;
  for (const QString& name : QDir(kMade).entryList({files}, QDir::Files)) {
    QFile file(QDir(kMade).filePath(name));
    if (file.open(QIODevice::ReadOnly)) pdf = file.readAll();
    file.remove();
  }
  return pdf;
}

}  // namespace kora::test
