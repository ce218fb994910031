#pragma once

#include <QPointer>
#include <QTableView>
#include <functional>
#include <string>
#include <vector>

#include "base/files.h"
#include "lists/grid_source.h"
#include "lists/text_print_out.h"

class QLineEdit;

namespace kora {

class Dialogs;
class SettingsFile;

struct GridServices {
  Dialogs& dialogs;
  const Files& files;
  // Where the column widths are kept: `section` and `key` of that file; null keeps none.
  SettingsFile* widths = nullptr;
  std::string section = {}, key = {};
};

// The grid of the program: rows that a source has, in columns.
//
//   TextGrid rows_;                                    // or a source of one's own
//   grid_ = new Grid(rows_, {dialogs, files, &user, "Charts", "Scan1_Form"},
//                    {{"Code", 8}, {"Last $", 9, true}}, "SS1", this);
//   grid_->SetZoom(settings.Zoom);
//   grid_->SetDeletable(true);
//   grid_->changed = [this] { changed_ = true; };
//   ...
//   rows_.rows.push_back({{"ORE", "1.20"}});
//   grid_->Refresh();                                  // what the source shows changed
//   ...
//   if (!grid_->EndEdit()) return;                     // before saving: what is being typed counts
//
// Keys: typing, F2 and a double click edit; Enter moves down, Tab to the right and from the last
// cell out of the grid, Ctrl+Tab leaves it anywhere; Esc leaves a cell as it was; Ctrl+C copies the
// selected block as tab-separated text, Ctrl+V pastes such text; Delete deletes the selected rows.
// A text that the source refuses is told, and the cell stays open with what was typed.
//
// The source must outlive the grid, or be taken along with it by the form that has both.
class Grid : public QTableView {
 public:
  Grid(GridSource& source, GridServices services, std::vector<GridColumn> columns,
       const QString& name, QWidget* parent);
  ~Grid() override;

  // The user changed something: edited, pasted, deleted or sorted.
  std::function<void()> changed = {};
  // Enter or a double click on a row that can't be edited. Without it Enter is left to the form.
  std::function<void(int row)> activated = {};
  // In place of the menu of the right button.
  std::function<void(int row)> rightClicked = {};

  // Percent of the size of the screen's font, 50 to 200, for all of the grid.
  void SetZoom(int percent);
  // A locked grid takes no edits, pastes and deletions.
  void SetLocked(bool locked);
  // Whether rows can be deleted, and whether the user is asked before they are.
  void SetDeletable(bool deletable, bool asks = true) {
    deletable_ = deletable;
    asksToDelete_ = asks;
  }
  // A click on a heading asks the source to sort.
  void SetSortable(bool sortable);
  // Selects rows as wholes.
  void SetWholeRows(bool whole);
  void SetHeading(int column, const std::string& heading);
  void SetColumnShown(int column, bool shown);
  bool ColumnShown(int column) const { return !isColumnHidden(column); }

  // The source has other rows, or other texts in them. Cell in hand, widths and place stay.
  void Refresh();
  void RefreshRow(int row);  // the texts of that row alone

  int CurrentRow() const { return currentIndex().row(); }        // -1 for none
  int CurrentColumn() const { return currentIndex().column(); }  // -1 for none
  // One cell in hand, in sight.
  void GoTo(int row, int column);
  // From the first to the last selected row; empty (count 0) when none is.
  RowBlock SelectedRows() const;
  void SelectRows(RowBlock rows);

  // Takes what is being typed. False when it is refused: told, and the cell is open still.
  bool EndEdit();
  // Deletes the selected rows from the source. False when nothing was deleted.
  bool DeleteSelected();
  bool CanDelete() const { return deletable_ && !locked_; }

  void Copy();
  void Paste();
  // The texts of the block, of the columns that are shown; with their headings for all rows.
  TextRows Texts(RowBlock rows) const;
  std::vector<std::string> Headings() const;
  // Asks for a file, then writes all rows to it. What fails is told.
  void SaveAs();
  void SaveCsv(const std::string& hostPath) const;
  // All rows, columns as wide as they are on the screen.
  TextTable ToPrint(const std::string& heading) const;

  // In pixels at 100 percent, of all columns.
  const std::vector<int>& Widths() const { return widths_; }
  void SetWidths(const std::vector<int>& widths);

 protected:
  void keyPressEvent(QKeyEvent* event) override;
  void contextMenuEvent(QContextMenuEvent* event) override;
  bool focusNextPrevChild(bool next) override;
  void commitData(QWidget* editor) override;
  void closeEditor(QWidget* editor, QAbstractItemDelegate::EndEditHint hint) override;
  void hideEvent(QHideEvent* event) override;

 private:
  class Model;
  class Delegate;
  enum class Step { kDown, kUp, kRight, kLeft };

  bool Editable(int column) const { return !locked_ && columns_[size_t(column)].editable; }
  bool AnyEditable() const;
  bool Move(Step step);  // false at the end
  void Finish(Step step);
  void Told(const Refusal& refusal);
  void HoldEditor();
  void Changed();
  void ApplyZoom();
  void ShowWidths();
  void KeepWidths();
  void ShowSort();
  QRect SelectedCells() const;

  GridSource& source_;
  GridServices services_;
  std::vector<GridColumn> columns_;
  Model* model_;
  // Asked for as it goes, when it is no more than a widget.
  QPointer<QWidget> editor_;
  QLineEdit* Editor() const;
  QPersistentModelIndex editing_;
  std::vector<int> widths_;  // as Widths()
  double baseSize_;          // points of the font at 100 percent
  int zoom_ = 100;
  int sorted_ = -1;
  bool descending_ = false;
  bool locked_ = false, deletable_ = false, asksToDelete_ = true, sortable_ = false;
  bool held_ = false;           // a refused text keeps its cell open
  bool settingWidths_ = false;  // by the program
  bool widthsChanged_ = false;
};

}  // namespace kora
