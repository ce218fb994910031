#pragma once

#include <QPointer>
#include <functional>
#include <string>
#include <vector>

#include "base/numbers.h"
#include "lists/grid_source.h"
#include "platform/dialogs.h"
#include "platform/qt/to_qt.h"
#include "scans/forms/scan_form.h"

namespace kora {

// A scan whose hits are its list of results as soon as it has ended: a row of List1 each.
template <typename Hit>
class HitsForm : public ScanForm {
 protected:
  using ScanForm::ScanForm;
  using Found = std::function<void(const Hit&)>;

  void LayOutHits(QWidget* criteria, const std::vector<std::string>& headings) {
    std::vector<GridColumn> columns;
    for (const std::string& heading : headings)
      columns.push_back({.heading = heading, .chars = 14, .right = true, .editable = false});
    columns[0].right = false;
    LayOut(criteria, "List1", std::move(columns), "", rows_);
    command1_->setText("&Scan Charts");
  }

  // `run` walks the market, `save` stores the hits, `ending` tells whether there were any.
  template <typename Result>
  void ScanForHits(std::string_view title,
                   const std::function<Result(const ScanRun&, const Found&)>& run,
                   const std::function<void()>& save, std::string (*ending)(bool any)) {
    const QPointer<HitsForm> here = this;
    Result result;
    bool done = false;
    RunScan(ToQt(title), [&](Progress& progress) {
      rows_.rows.clear();
      hits_.clear();
      stored_ = false;
      grid_->Refresh();
      result = run(Scan(progress), [&](const Hit& hit) {
        if (!here) return;
        hits_.push_back(hit);
        rows_.rows.push_back({CellsOf(hit)});
        RowAdded();
      });
      done = true;
    });
    if (!here || !done) return;
    if (result.stopped && (hits_.empty() || !AskStopped(title))) return;
    if (!here) return;
    stored_ = Store(title, save);
    if (!stored_ || result.stopped) return;
    TellEnd(title, ending(!hits_.empty()), result.unread);
    if (here && !hits_.empty()) grid_->setFocus();
  }

  void PrintTable(const TextTable& table) {
    panel_->Show("PRINTING  -  WAIT");
    services_.print(table, this);
    panel_->Show({});
  }

  void OpenRow(int row) override {
    if (panel_->running()) return;
    if (stored_ && services_.openResult) services_.openResult(CInt(row + 1.0));
    if (!stored_ && services_.openRecord) services_.openRecord(hits_[size_t(row)].record);
  }

  const std::vector<Hit>& hits() const { return hits_; }

 private:
  TextGrid rows_;
  std::vector<Hit> hits_;  // a row each
  bool stored_ = false;    // the hits are the list of results
};

}  // namespace kora
