#pragma once

#include <memory>

#include "companies/company_grid.h"
#include "companies/forms/StockInf.h"
#include "lists/forms/work_panel.h"

namespace kora {

// "ASX Details": all companies with yields and filters.
class Fundmnt : public QDialog {
 public:
  Fundmnt(CompanyFormServices services, QWidget* parent);
  ~Fundmnt() override;

  // False, and told, when there is no data or it can't be read.
  bool Fill();
  void reject() override;

 private:
  class Source;

  void AddMenu();
  void ShowClass();
  void Yields();
  void InsertClasses();
  void MakeList();
  void HideColumn();
  void SeeAll();
  void CopyToNames();

  CompanyFormServices services_;
  std::optional<CompanyStore> store_;
  std::unique_ptr<Source> source_;
  Grid* ss1_ = nullptr;
  QLineEdit* text1_ = nullptr;
  WorkPanel* panel_ = nullptr;
};

}  // namespace kora
