#pragma once

#include <QPointer>
#include <functional>

#include "companies/forms/StockInf.h"
#include "shell/session.h"

class QDialog;
class QWidget;

namespace kora {

struct CompanyDeskHooks {
  std::function<void(const TextTable&, QWidget* over)> printTable;
  std::function<void(QWidget* over)> pageSetup;
  std::function<int(QWidget* over)> changeSize;
  // The name file took details of companies.
  std::function<void()> namesChanged;
};

// The forms of company details and of the market snapshot. It lives as long as the main window.
class CompanyDesk {
 public:
  CompanyDesk(Session& session, QWidget* over, CompanyDeskHooks hooks);

  void OpenCompanies();  // Fundmnt, or the message that there is no data
  void OpenSnapshot();   // ChtSnap
  // StockInf of a code over the chart; it follows when it is called again.
  void ShowStock(const std::string& code, QWidget* over);
  bool CanShowStock() const;

 private:
  CompanyFormServices Services() const;

  Session& session_;
  QWidget* over_;
  CompanyDeskHooks hooks_;
  QPointer<QDialog> companies_, snapshot_;
  QPointer<StockInf> stock_;
};

}  // namespace kora
