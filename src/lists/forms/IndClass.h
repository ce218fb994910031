#pragma once

#include <QDialog>
#include <functional>
#include <memory>
#include <string>

#include "lists/forms/grid.h"
#include "store/industry_classes.h"

namespace kora {

// The table of industry classes: to edit, or to pick one from.
class IndClass : public QDialog {
 public:
  enum class Use { kPick, kEdit };
  // `user` keeps the widths of the columns; null keeps none.
  IndClass(const Files& files, Dialogs& dialogs, const std::string& systemPath, QWidget* parent,
           Use use = Use::kPick, SettingsFile* user = nullptr);
  ~IndClass() override;

  // The row of that class is the one in hand.
  void Select(const std::string& id);
  // The id in hand once the form was accepted; empty when there is no class at all.
  std::string chosen() const;
  // Percent of the size of the table.
  void SetZoom(int percent);
  // Asks the user for that size over a form, for the entry "Display".
  std::function<int(QWidget* over)> changeSize = {};

  // A changed table is saved first; where another program changed it since, the user is asked, and
  // No closes without saving.
  void reject() override;

 private:
  class Source;

  void AddEditMenu();

  const Files& files_;
  Dialogs& dialogs_;
  const std::string systemPath_;
  std::unique_ptr<Source> source_;
  Grid* grid_;
  FileStamp stamp_;  // of the table as it was read
  bool changed_ = false;
};

}  // namespace kora
