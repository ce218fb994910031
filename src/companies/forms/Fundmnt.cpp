#include "companies/forms/Fundmnt.h"

#include <QLabel>
#include <QLineEdit>
#include <QMenuBar>
#include <QVBoxLayout>
#include <algorithm>

#include "base/runtime_error.h"
#include "base/text.h"
#include "platform/dialogs.h"
#include "platform/qt/form_parts.h"

namespace kora {
namespace {

constexpr int kFixedColumns = 6;

}  // namespace

// The companies that the class typed above lets through, in the order of the grid.
class Fundmnt::Source : public GridSource {
 public:
  std::vector<CompanyRow> rows;
  std::vector<size_t> shown;

  int RowCount() const override { return int(shown.size()); }
  std::string Text(int row, int column) const override {
    const CompanyRow& one = rows[shown[size_t(row)]];
    switch (column) {
      case 0: return one.code;
      case 1: return one.name;
      case 2: return one.IndClass;
      case 3: return one.lastDate;
      case 4: return one.price;
      case 5: return one.yield;
      default: return one.fields[size_t(column - kFixedColumns)];
    }
  }
  std::string RowName(int row) const override { return Text(row, 0); }
  bool Sort(int column, bool descending) override {
    std::stable_sort(shown.begin(), shown.end(), [&](size_t a, size_t b) {
      const std::string x = Cell(a, column), y = Cell(b, column);
      return descending ? CellBefore(y, x) : CellBefore(x, y);
    });
    return true;
  }
  void Show(std::string_view industryClass) {
    shown.clear();
    for (size_t i = 0; i < rows.size(); ++i)
      if (industryClass.empty() || rows[i].IndClass == industryClass) shown.push_back(i);
  }

 private:
  std::string Cell(size_t row, int column) const { return CompanyCells(rows[row])[size_t(column)]; }
};

Fundmnt::Fundmnt(CompanyFormServices services, QWidget* parent)
    : QDialog(parent), services_(std::move(services)), source_(std::make_unique<Source>()) {
  setObjectName("Fundmnt");
  setWindowTitle(ToQt(kCompanyTitle));
  setWindowFlag(Qt::WindowMaximizeButtonHint);
}

// A cell in hand asks the rows once more as it goes.
Fundmnt::~Fundmnt() { delete ss1_; }

bool Fundmnt::Fill() {
  if (!KoraDetailsReady(services_.files, services_.settings.download)) {
    services_.dialogs.Message(kNoCompanies, kCompanyTitle);
    return false;
  }
  try {
    store_.emplace(services_.files, services_.settings.download);
    source_->rows =
        LoadCompanies(*store_, services_.files, services_.settings.paths.CurrentDataPath);
  } catch (const RunTimeError& e) {
    services_.dialogs.Message(e.what(), kCompanyTitle);
    return false;
  }
  source_->Show("");
  std::vector<GridColumn> columns;
  for (const std::string& heading : CompanyHeadings(*store_))
    columns.push_back({.heading = heading, .chars = 14, .editable = false});
  columns[0].chars = 8;
  columns[1].chars = 32;
  columns[2].chars = 10;
  columns[4].right = columns[5].right = true;
  ss1_ = new Grid(*source_,
                  {.dialogs = services_.dialogs,
                   .files = services_.files,
                   .widths = &services_.user,
                   .section = std::string(kUserSection),
                   .key = "Fundmnt_Form"},
                  std::move(columns), "SS1", this);
  ss1_->setAccessibleName(ToQt(kCompanyTitle));
  ss1_->SetZoom(services_.settings.Zoom);
  ss1_->SetLocked(true);
  ss1_->SetSortable(true);
  text1_ = NewField(this, "Text1", 5, 3);
  connect(text1_, &QLineEdit::textChanged, this, [this] { ShowClass(); });
  panel_ = new WorkPanel(this);
  auto* top = new QHBoxLayout;
  top->addWidget(NewLabel(this, "Industry c&lass", text1_));
  top->addWidget(text1_);
  top->addStretch();
  auto* rows = new QVBoxLayout(this);
  rows->addLayout(top);
  rows->addWidget(ss1_);
  rows->addWidget(panel_);
  AddMenu();
  panel_->Hold({text1_, layout()->menuBar()});
  ss1_->GoTo(0, 0);
  SizeInLetters(this, 140, 34);
  return true;
}

void Fundmnt::AddMenu() {
  auto* bar = new QMenuBar(this);
  layout()->setMenuBar(bar);
  QMenu* menu = bar->addMenu("&Details");
  menu->setObjectName("mnFrm");
  AddEntry(this, menu, "mnYCP", "Calculate &Yields %", [this] { Yields(); });
  AddEntry(this, menu, "mnInGrp", "Insert &Industry Classifications", [this] { InsertClasses(); });
  AddEntry(this, menu, "mnScanList", "Make Chart &List of these", [this] { MakeList(); });
  menu->addSeparator();
  AddEntry(this, menu, "mnHdCol", "&Hide Column", [this] { HideColumn(); });
  AddEntry(this, menu, "mnSeeAll", "See &All", [this] { SeeAll(); });
  AddEntry(this, menu, "mnCngDisp", "Change &Display", [this] {
    if (services_.changeSize) ss1_->SetZoom(services_.changeSize(this));
  });
  menu->addSeparator();
  AddEntry(this, menu, "mnUpName", "&Copy to Name file", [this] { CopyToNames(); });
  AddEntry(this, menu, "mnPrint", "&Print", [this] {
    services_.print(ss1_->ToPrint(std::string(kCompanyTitle)), this);
  })->setEnabled(bool(services_.print));
  AddEntry(this, menu, "mnSaveAs", "&Save As (.csv)", [this] { ss1_->SaveAs(); });
  AddEntry(this, menu, "mnClse", "Cl&ose", [this] { reject(); });
}

void Fundmnt::ShowClass() {
  source_->Show(std::string(Trim(text1_->text().toStdString())));
  ss1_->Refresh();
}

void Fundmnt::Yields() {
  YieldEnd end;
  panel_->Run(ToQt(kCalculatingYields), [&](Progress& progress) {
    end = CalculateYields(*store_, services_.files, services_.settings.paths.CurrentDataPath,
                          progress, source_->rows);
  });
  ss1_->Refresh();
  panel_->Show("");
  if (!end.missing.empty()) services_.dialogs.Message(MissingText(end.missing), kCompanyTitle);
}

void Fundmnt::InsertClasses() {
  try {
    const auto fresh =
        LoadCompanies(*store_, services_.files, services_.settings.paths.CurrentDataPath);
    for (size_t i = 0; i < fresh.size(); ++i) {
      source_->rows[i].name = fresh[i].name;
      source_->rows[i].IndClass = fresh[i].IndClass;
      source_->rows[i].nameRec = fresh[i].nameRec;
    }
  } catch (const RunTimeError& e) {
    services_.dialogs.Message(e.what(), kCompanyTitle);
  }
  ShowClass();
}

void Fundmnt::MakeList() {
  std::vector<CompanyRow> rows;
  for (const size_t row : source_->shown) rows.push_back(source_->rows[row]);
  try {
    WriteCompanyList(services_.files, services_.settings.paths.CurrentDataPath, rows);
    panel_->Show("Chart Scan Results has these securities now");
  } catch (const RunTimeError& e) {
    services_.dialogs.Message(e.what(), kCompanyTitle);
  }
}

void Fundmnt::HideColumn() {
  const int column = ss1_->CurrentColumn();
  if (column > 0) ss1_->SetColumnShown(column, false);
}

void Fundmnt::SeeAll() {
  for (int column = 0; column < ss1_->model()->columnCount(); ++column)
    ss1_->SetColumnShown(column, true);
  text1_->clear();
}

void Fundmnt::CopyToNames() {
  const int column = ss1_->CurrentColumn();
  if (column < 0 || source_->shown.empty()) return;
  const std::string heading =
      ss1_->model()->headerData(column, Qt::Horizontal).toString().toStdString();
  if (services_.dialogs.Ask(TransferQuestion(heading), kTransferTitle, Buttons::kYesNo) !=
      Answer::kYes)
    return;
  std::vector<Transfer> details;
  for (int row = 0; row < source_->RowCount(); ++row)
    details.push_back({source_->Text(row, 0), source_->Text(row, column)});
  try {
    TransferDetails(services_.files, services_.settings.paths.CurrentDataPath, details);
    if (services_.namesChanged) services_.namesChanged();
  } catch (const RunTimeError& e) {
    services_.dialogs.Message(e.what(), kTransferTitle);
  }
}

void Fundmnt::reject() {
  if (panel_ && panel_->StopFirst()) return;
  QDialog::reject();
}

}  // namespace kora
