#pragma once

#include <QDialog>
#include <functional>

#include "platform/dialogs.h"
#include "settings/locate.h"

class QComboBox;
class QLabel;
class QListWidget;

namespace kora {

// "Modify File Locations": a drive and a folder on it.
class Locate : public QDialog {
 public:
  // `saved` takes the folder, which ends in "\".
  Locate(const Files& files, Dialogs& dialogs, const LocateCase& what,
         std::function<void(const std::string&)> saved, QWidget* parent);

 protected:
  bool eventFilter(QObject* object, QEvent* event) override;

 private:
  void ShowFolder(const std::string& folder);
  void Enter(const QString& name);
  void Save();

  const Files& files_;
  Dialogs& dialogs_;
  std::function<void(const std::string&)> saved_;
  std::string folder_;
  QComboBox* drive1_;
  QListWidget* dir1_;
  QLabel* label3_[2];
};

}  // namespace kora
