#pragma once

#include <QWidget>
#include <functional>
#include <string>

#include "base/files.h"

class QComboBox;
class QListWidget;

namespace kora {

// A drive and a folder on it: a list of the folders below the one chosen, into which a double click
// and Enter go.
class FolderPicker : public QWidget {
 public:
  // `index` goes behind the names of the controls, as "(0)"; `driveCaption` and `folderCaption`
  // have their mnemonics.
  FolderPicker(const Files& files, const QString& index, const QString& driveCaption,
               const QString& folderCaption, QWidget* parent);

  // Another folder is on show.
  std::function<void()> changed = {};

  // The nearest folder that is there.
  void SetFolder(const std::string& folder);
  const std::string& folder() const { return folder_; }  // ends in "\"; empty for none
  // The folders below it, read again.
  void Refresh() { ShowFolder(folder_); }
  void FocusList();

 protected:
  bool eventFilter(QObject* object, QEvent* event) override;

 private:
  void ShowFolder(const std::string& folder);
  void Enter(const QString& name);

  const Files& files_;
  std::string folder_;
  QComboBox* drive1_;
  QListWidget* dir1_;
};

}  // namespace kora
