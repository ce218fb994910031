#pragma once

#include <QDialog>
#include <functional>
#include <optional>

#include "companies/stock_details.h"
#include "lists/forms/grid.h"

class QLineEdit;

namespace kora {

struct CompanyFormServices {
  const Files& files;
  Settings& settings;
  Dialogs& dialogs;
  SettingsFile& user;
  std::function<void(const TextTable&, QWidget* over)> print = {};
  std::function<void()> namesChanged = {};  // the name file took a detail
  std::function<int(QWidget* over)> changeSize = {};
  std::function<std::string()> currentCode = {};  // of the security on the chart
};

// The details of one company. A click on a line offers it to the name file. It follows the chart when
// it becomes the active window.
class StockInf : public QDialog {
 public:
  StockInf(CompanyFormServices services, QWidget* parent);
  ~StockInf() override;

  // False, and told, when the store can't be read.
  bool Fill();
  // Shows the company of a code, trimmed; its title is the code.
  void Show(const std::string& code);

 protected:
  bool event(QEvent* event) override;

 private:
  void Offer(int row);
  std::string WidthsFile() const;

  CompanyFormServices services_;
  std::optional<CompanyStore> store_;
  std::string code_;
  std::string onChart_;  // when it last looked
  TextGrid rows_;
  QLineEdit* text1_;
  Grid* listView1_;
};

}  // namespace kora
