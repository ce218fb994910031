#include "lists/forms/IndClass.h"

#include <QHeaderView>
#include <QMenuBar>
#include <QVBoxLayout>

#include "base/runtime_error.h"
#include "lists/chart_list.h"
#include "lists/forms/list_box.h"
#include "platform/dialogs.h"
#include "platform/qt/form_parts.h"
#include "platform/settings_file.h"

namespace kora {
namespace {

constexpr const char* kTitle = "Industry Classification";

}  // namespace

class IndClass::Source : public GridSource {
 public:
  std::vector<IndustryClass> rows;

  int RowCount() const override { return int(rows.size()); }
  std::string Text(int row, int column) const override {
    return column == 0 ? rows[size_t(row)].id : rows[size_t(row)].description;
  }
  std::string RowName(int row) const override { return rows[size_t(row)].id; }
  std::optional<Refusal> SetText(int row, int column, const std::string& text) override {
    IndustryClass& one = rows[size_t(row)];
    const auto fault = column == 0 ? PutClassId(one, text) : PutClassDescription(one, text);
    return fault ? std::optional<Refusal>({*fault, kTitle}) : std::nullopt;
  }
  void DeleteRows(RowBlock block) override { RemoveBlock(rows, block); }
};

IndClass::IndClass(const Files& files, Dialogs& dialogs, const std::string& systemPath,
                   QWidget* parent, Use use, SettingsFile* user)
    : QDialog(parent),
      files_(files),
      dialogs_(dialogs),
      systemPath_(systemPath),
      source_(std::make_unique<Source>()) {
  setObjectName("IndClass");
  setWindowTitle(kTitle);
  TellErrors(dialogs_, kTitle, [&] {
    stamp_ = files_.Stamp(IndustryClassFile(systemPath_));
    source_->rows = ReadIndustryClasses(files_, systemPath_);
  });

  grid_ = new Grid(*source_,
                   {.dialogs = dialogs_,
                    .files = files_,
                    .widths = user,
                    .section = std::string(kUserSection),
                    .key = "IndClass"},
                   {{.heading = "Class Id", .chars = 10, .limit = 3},
                    {.heading = "Industry Classification", .chars = 40}},
                   "SS1", this);
  grid_->setAccessibleName(kTitle);
  grid_->horizontalHeader()->setStretchLastSection(true);
  grid_->setMinimumSize(fontMetrics().averageCharWidth() * 55, fontMetrics().height() * 18);

  auto* buttons = new ButtonRow(this);
  if (use == Use::kPick) {
    grid_->SetWholeRows(true);
    grid_->SetLocked(true);
    grid_->activated = [this](int) { accept(); };
    buttons->Add("Command1", "&Select", [this] { accept(); });
  } else {
    grid_->SetDeletable(true);
    grid_->changed = [this] { changed_ = true; };
  }
  buttons->Add("Command2", "&Close", [this] { reject(); });
  auto* rows = new QVBoxLayout(this);
  if (use == Use::kEdit) AddEditMenu();
  rows->addWidget(grid_);
  rows->addLayout(buttons);
  grid_->GoTo(0, 0);
  if (use == Use::kPick) grid_->SelectRows({0, 0});
}

// A cell that is open asks the rows once more as it goes.
IndClass::~IndClass() { delete grid_; }

void IndClass::AddEditMenu() {
  auto* bar = new QMenuBar(this);
  layout()->setMenuBar(bar);
  QMenu* edit = bar->addMenu("&Edit");
  edit->setObjectName("icEdit");
  const auto entry = [&](const char* name, const char* caption, auto work) {
    edit->addAction(caption, this, work)->setObjectName(name);
  };
  entry("icAddRow", "&Add Row", [this] {
    if (!grid_->EndEdit()) return;
    source_->rows.emplace_back();
    grid_->Refresh();
    grid_->GoTo(source_->RowCount() - 1, 0);
    grid_->setFocus();
    changed_ = true;
  });
  entry("icDelRw", "&Delete Row", [this] { grid_->DeleteSelected(); });
  entry("icSrtIC", "&Sort List", [this] {
    if (!grid_->EndEdit()) return;
    SortIC(source_->rows);
    grid_->Refresh();
    changed_ = true;
  });
  entry("icDisp", "Dis&play", [this] {
    if (changeSize) grid_->SetZoom(changeSize(this));
  });
  entry("icSave", "&Close", [this] { reject(); });
}

void IndClass::SetZoom(int percent) { grid_->SetZoom(percent); }

void IndClass::reject() {
  if (!grid_->EndEdit()) return;
  if (changed_) {
    try {
      const auto held = files_.lock().Hold();
      const Answer answer = files_.Stamp(IndustryClassFile(systemPath_)) == stamp_
                                ? Answer::kYes
                                : dialogs_.Ask(kListChangedOutside, kTitle, Buttons::kYesNoCancel);
      if (answer == Answer::kCancel) return;
      if (answer == Answer::kYes) WriteIndustryClasses(files_, systemPath_, source_->rows);
    } catch (const RunTimeError& e) {
      const std::string text = std::string(e.what()) + "\nClose without saving ?";
      if (dialogs_.Ask(text, kTitle, Buttons::kYesNo) != Answer::kYes) return;
    }
  }
  QDialog::reject();
}

void IndClass::Select(const std::string& id) {
  for (int row = 0; row < source_->RowCount(); ++row) {
    if (source_->rows[size_t(row)].id != id) continue;
    grid_->GoTo(row, 0);
    grid_->SelectRows({row, row});
    return;
  }
}

std::string IndClass::chosen() const {
  const int row = grid_->CurrentRow();
  return row < 0 ? std::string() : source_->rows[size_t(row)].id;
}

}  // namespace kora
