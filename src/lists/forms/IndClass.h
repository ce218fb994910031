#pragma once

#include <QDialog>
#include <string>

#include "base/files.h"
#include "lists/industry_classes.h"

class QTableWidget;

namespace kora {

class Dialogs;

// The table of industry classes, to pick one from.
class IndClass : public QDialog {
 public:
  IndClass(const Files& files, Dialogs& dialogs, const std::string& systemPath, QWidget* parent);

  // The row of that class is the one in hand.
  void Select(const std::string& id);
  // The id in hand once the form was accepted; empty when there is no class at all.
  std::string chosen() const;

 private:
  QTableWidget* grid_;
};

}  // namespace kora
