#pragma once

#include <QDialog>
#include <functional>

#include "platform/dialogs.h"
#include "settings/forms/folder_picker.h"
#include "settings/locate.h"

class QLabel;

namespace kora {

// "Modify File Locations": a drive and a folder on it.
class Locate : public QDialog {
 public:
  // `saved` takes the folder, which ends in "\".
  Locate(const Files& files, Dialogs& dialogs, const LocateCase& what,
         std::function<void(const std::string&)> saved, QWidget* parent);

 private:
  void Save();

  Dialogs& dialogs_;
  std::function<void(const std::string&)> saved_;
  FolderPicker* picker_;
  QLabel* label3_[2];
};

}  // namespace kora
