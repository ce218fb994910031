#pragma once

#include <QProcess>
#include <QTemporaryDir>

namespace kora::test {

// A CUPS of the test's own with one queue, "KoraPdf", which makes PDFs. It listens on a socket in
// its temporary folder, where it keeps all of its files, and ends with the object.
class CupsQueue {
 public:
  static constexpr const char* kName = "KoraPdf";

  // What this machine lacks to run one; empty where it can.
  static QString Missing();

  // Starts the daemon, makes this process a client of it, and adds the queue. Must come before
  // anything here speaks to CUPS: a client keeps the server that it met first.
  CupsQueue();
  ~CupsQueue();

  bool Works() const { return works_; }
  // What went wrong, for the message of a test that fails.
  QString Log() const;

  // Runs one of the programs of CUPS on the queue. False when it fails.
  bool Run(const QString& program, const QStringList& arguments) const;
  bool AddQueue() const;
  // The numbers of the documents that the queue is done with, in their order.
  QList<int> Done() const;
  // Waits until the queue is done with a document that is not in `before`, and gives its PDF;
  // empty when none comes.
  QByteArray NextPdf(const QList<int>& before) const;

 private:
  QTemporaryDir folder_;
  QProcess daemon_;
  bool works_ = false;
};

}  // namespace kora::test
