#include "companies/forms/StockInf.h"

#include <QEvent>
#include <QHBoxLayout>
#include <QHeaderView>
#include <QLabel>
#include <QLineEdit>
#include <QVBoxLayout>

#include "base/runtime_error.h"
#include "base/text.h"
#include "companies/company_grid.h"
#include "platform/dialogs.h"
#include "platform/qt/form_parts.h"

namespace kora {
namespace {

constexpr std::uint64_t kLargestWidths = 4096;

}  // namespace

StockInf::StockInf(CompanyFormServices services, QWidget* parent)
    : QDialog(parent), services_(std::move(services)) {
  setObjectName("StockInf");
  text1_ = NewField(this, "Text1", 8, 6);
  auto* top = new QHBoxLayout;
  top->addWidget(NewLabel(this, "&Code", text1_));
  top->addWidget(text1_);
  top->addStretch();
  listView1_ = new Grid(rows_, {.dialogs = services_.dialogs, .files = services_.files},
                        {{.heading = "Description", .chars = 24, .editable = false},
                         {.heading = "Value", .chars = 30, .editable = false}},
                        "ListView1", this);
  listView1_->setAccessibleName("Company details");
  listView1_->SetZoom(services_.settings.Zoom);
  listView1_->SetLocked(true);
  listView1_->SetWholeRows(true);
  listView1_->horizontalHeader()->setStretchLastSection(true);
  listView1_->activated = [this](int row) { Offer(row); };
  connect(listView1_, &QTableView::clicked, this,
          [this](const QModelIndex& index) { Offer(index.row()); });
  connect(text1_, &QLineEdit::returnPressed, this, [this] { Show(text1_->text().toStdString()); });
  auto* rows = new QVBoxLayout(this);
  rows->addLayout(top);
  rows->addWidget(listView1_);
  resize(fontMetrics().averageCharWidth() * 64, fontMetrics().height() * 26);
}

StockInf::~StockInf() {
  try {
    const std::string text = WidthsText(listView1_->Widths()) + "\r\n";
    if (store_ && (!services_.files.CheckFile(WidthsFile()) ||
                   services_.files.ReadAll(WidthsFile(), kLargestWidths) != text))
      services_.files.WriteAll(WidthsFile(), text);
  } catch (const RunTimeError&) {
    // Widths that can't be kept are those of before, the next time.
  }
  delete listView1_;
}

std::string StockInf::WidthsFile() const {
  return WithBackslash(Trim(services_.settings.download.ServiceSystem)) + "LVCols.txt";
}

bool StockInf::Fill() {
  try {
    store_.emplace(services_.files, services_.settings.download);
  } catch (const RunTimeError& e) {
    services_.dialogs.Message(e.what(), kCompanyTitle);
    return false;
  }
  try {
    if (services_.files.CheckFile(WidthsFile()))
      listView1_->SetWidths(ParseWidths(services_.files.ReadAll(WidthsFile(), kLargestWidths)));
  } catch (const RunTimeError&) {
    // The widths of a first time.
  }
  return true;
}

bool StockInf::event(QEvent* event) {
  if (event->type() == QEvent::WindowActivate && store_ && services_.currentCode &&
      services_.currentCode() != onChart_)
    Show(services_.currentCode());
  return QDialog::event(event);
}

void StockInf::Show(const std::string& code) {
  if (services_.currentCode) onChart_ = services_.currentCode();
  code_ = UCase(Trim(code));
  setWindowTitle(ToQt(code_));
  text1_->setText(ToQt(code_));
  rows_.rows.clear();
  for (const StockDetail& detail : GetStockDetails(*store_, code_))
    rows_.rows.push_back({{detail.description, detail.value}});
  if (rows_.rows.empty()) rows_.rows.push_back({{"No details for " + code_, ""}});
  listView1_->Refresh();
}

void StockInf::Offer(int row) {
  if (row < 0 || store_->Find(code_) == 0) return;
  const std::string description = rows_.Text(row, 0);
  if (services_.dialogs.Ask(TransferQuestion(description), kTransferTitle, Buttons::kYesNo) !=
      Answer::kYes)
    return;
  try {
    TransferDetails(services_.files, services_.settings.paths.CurrentDataPath,
                    {{code_, rows_.Text(row, 1)}});
    if (services_.namesChanged) services_.namesChanged();
  } catch (const RunTimeError& e) {
    services_.dialogs.Message(e.what(), kTransferTitle);
  }
}

}  // namespace kora
