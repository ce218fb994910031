#include "lists/forms/grid.h"

#include <QAbstractTableModel>
#include <QApplication>
#include <QClipboard>
#include <QContextMenuEvent>
#include <QFileDialog>
#include <QHeaderView>
#include <QLineEdit>
#include <QMenu>
#include <QRegularExpressionValidator>
#include <QStyledItemDelegate>
#include <QTimer>
#include <algorithm>

#include "base/host_files.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "platform/dialogs.h"
#include "platform/qt/modal.h"
#include "platform/qt/to_qt.h"
#include "platform/settings_file.h"

namespace kora {
namespace {

constexpr int kLeastZoom = 50, kMostZoom = 200;
constexpr double kFallbackPoints = 9;

// `share` of one colour over another: legible on light and dark screens alike.
QColor Mix(const QColor& over, const QColor& under, double share) {
  const auto mix = [share](int a, int b) { return int(a * share + b * (1 - share)); };
  return QColor(mix(over.red(), under.red()), mix(over.green(), under.green()),
                mix(over.blue(), under.blue()));
}

bool IsDark(const QPalette& colours) { return colours.color(QPalette::Base).lightness() < 128; }

QVariant Background(GridShade shade, const QPalette& colours) {
  const QColor base = colours.color(QPalette::Base);
  if (shade == GridShade::kDone) return Mix(QColor(0, 160, 0), base, 0.28);
  if (shade == GridShade::kMarked) return Mix(QColor(230, 180, 0), base, 0.35);
  return {};
}

QVariant Foreground(GridShade shade, const QPalette& colours) {
  if (shade == GridShade::kFaint) return colours.color(QPalette::Disabled, QPalette::Text);
  if (shade == GridShade::kFall) return IsDark(colours) ? QColor(255, 120, 110) : QColor(192, 0, 0);
  return {};
}

// What was pasted may be longer than any message.
std::string ForMessage(const QString& text) {
  constexpr qsizetype kLongest = 60;
  return (text.size() > kLongest ? text.left(kLongest) + "..." : text).toStdString();
}

}  // namespace

// ---- The source as Qt reads it

class Grid::Model : public QAbstractTableModel {
 public:
  Model(Grid& grid, GridSource& source) : QAbstractTableModel(&grid), grid_(grid), source_(source) {
    rows_ = source_.RowCount();
  }

  int rowCount(const QModelIndex& parent = {}) const override {
    return parent.isValid() ? 0 : rows_;
  }
  int columnCount(const QModelIndex& parent = {}) const override {
    return parent.isValid() ? 0 : int(grid_.columns_.size());
  }

  QVariant data(const QModelIndex& index, int role) const override {
    // A source that lost rows is asked for no others until the grid is told.
    if (!index.isValid() || index.row() >= source_.RowCount()) return {};
    const int row = index.row(), column = index.column();
    switch (role) {
      case Qt::DisplayRole:
      case Qt::EditRole: return ToQt(TextAt(row, column));
      case Qt::TextAlignmentRole:
        return int((grid_.columns_[size_t(column)].right ? Qt::AlignRight : Qt::AlignLeft) |
                   Qt::AlignVCenter);
      case Qt::BackgroundRole: return Background(source_.Shade(row, column), grid_.palette());
      case Qt::ForegroundRole: return Foreground(source_.Shade(row, column), grid_.palette());
      default: return {};
    }
  }

  QVariant headerData(int section, Qt::Orientation orientation, int role) const override {
    if (role != Qt::DisplayRole) {
      if (role == Qt::TextAlignmentRole && orientation == Qt::Vertical)
        return int(Qt::AlignRight | Qt::AlignVCenter);
      return {};
    }
    if (orientation == Qt::Vertical) return section + 1;
    return ToQt(grid_.columns_[size_t(section)].heading);
  }

  Qt::ItemFlags flags(const QModelIndex& index) const override {
    Qt::ItemFlags flags = Qt::ItemIsEnabled | Qt::ItemIsSelectable | Qt::ItemNeverHasChildren;
    if (index.isValid() && grid_.Editable(index.column())) flags |= Qt::ItemIsEditable;
    return flags;
  }

  // The number of rows follows the source at the end of the table, so that the cell in hand and
  // the place on the screen stay.
  void Follow() {
    const int now = source_.RowCount();
    if (now < rows_) {
      beginRemoveRows({}, now, rows_ - 1);
      rows_ = now;
      endRemoveRows();
    } else if (now > rows_) {
      beginInsertRows({}, rows_, now - 1);
      rows_ = now;
      endInsertRows();
    }
    if (rows_ > 0) Q_EMIT dataChanged(index(0, 0), index(rows_ - 1, columnCount() - 1));
  }
  void RowChanged(int row) {
    if (row < rows_) Q_EMIT dataChanged(index(row, 0), index(row, columnCount() - 1));
  }
  void HeadingChanged(int column) { Q_EMIT headerDataChanged(Qt::Horizontal, column, column); }

 private:
  // What can't be read shows as an empty cell: a picture of the screen is no place for a message.
  std::string TextAt(int row, int column) const {
    try {
      return source_.Text(row, column);
    } catch (const RunTimeError&) {
      return {};
    }
  }

  Grid& grid_;
  GridSource& source_;
  int rows_ = 0;
};

// ---- The editor of a cell

class Grid::Delegate : public QStyledItemDelegate {
 public:
  explicit Delegate(Grid& grid) : QStyledItemDelegate(&grid), grid_(grid) {}

  QWidget* createEditor(QWidget* parent, const QStyleOptionViewItem&,
                        const QModelIndex& index) const override {
    const GridColumn& column = grid_.columns_[size_t(index.column())];
    auto* editor = new QLineEdit(parent);
    editor->setObjectName("CellEditor");
    editor->setAccessibleName(ToQt(column.heading).simplified());
    editor->setFrame(false);
    if (column.limit > 0) editor->setMaxLength(column.limit);
    if (!column.typing.empty())
      editor->setValidator(
          new QRegularExpressionValidator(QRegularExpression(ToQt(column.typing)), editor));
    grid_.editor_ = editor;
    grid_.editing_ = index;
    return editor;
  }

 protected:
  bool eventFilter(QObject* object, QEvent* event) override {
    if (object == grid_.editor_ && event->type() == QEvent::KeyPress) {
      switch (static_cast<QKeyEvent*>(event)->key()) {
        case Qt::Key_Return:
        case Qt::Key_Enter:
        case Qt::Key_Down: grid_.Finish(Step::kDown); return true;
        case Qt::Key_Up: grid_.Finish(Step::kUp); return true;
        case Qt::Key_Tab: grid_.Finish(Step::kRight); return true;
        case Qt::Key_Backtab: grid_.Finish(Step::kLeft); return true;
        default: break;
      }
    }
    return QStyledItemDelegate::eventFilter(object, event);
  }

 private:
  Grid& grid_;
};

// ---- The grid

Grid::Grid(GridSource& source, GridServices services, std::vector<GridColumn> columns,
           const QString& name, QWidget* parent)
    : QTableView(parent),
      source_(source),
      services_(std::move(services)),
      columns_(std::move(columns)) {
  setObjectName(name);
  baseSize_ = font().pointSizeF() > 0 ? font().pointSizeF() : kFallbackPoints;
  model_ = new Model(*this, source_);
  setModel(model_);
  setItemDelegate(new Delegate(*this));
  setSelectionMode(QAbstractItemView::ContiguousSelection);
  setEditTriggers(DoubleClicked | EditKeyPressed | AnyKeyPressed);
  setTabKeyNavigation(true);
  setWordWrap(false);
  setCornerButtonEnabled(false);
  setVerticalScrollMode(ScrollPerItem);
  setHorizontalScrollMode(ScrollPerPixel);
  horizontalHeader()->setHighlightSections(false);
  horizontalHeader()->setMinimumSectionSize(8);
  verticalHeader()->setSectionResizeMode(QHeaderView::Fixed);
  ApplyZoom();
  for (size_t i = 0; i < columns_.size(); ++i) {
    const int heading = horizontalHeader()->sectionSizeHint(int(i));
    widths_.push_back(
        std::max(fontMetrics().averageCharWidth() * (columns_[i].chars + 2), heading));
  }
  for (size_t i = 0; i < columns_.size(); ++i)
    if (columns_[i].hidden) setColumnHidden(int(i), true);
  SetWidths(services_.widths
                ? ParseWidths(services_.widths->GetSetting(services_.section, services_.key))
                : std::vector<int>());
  connect(horizontalHeader(), &QHeaderView::sectionResized, this, [this](int column, int, int now) {
    if (settingWidths_ || now <= 0) return;
    widths_[size_t(column)] = std::max(1, (now * 100 + zoom_ / 2) / zoom_);
    widthsChanged_ = true;
  });
  connect(horizontalHeader(), &QHeaderView::sectionClicked, this, [this](int column) {
    if (!sortable_ || !EndEdit()) return;
    // The press has selected the whole column, which what comes next would take for all rows:
    // in the end one cell is.
    const bool descending = column == sorted_ && !descending_;
    try {
      if (!source_.Sort(column, descending)) {
        ShowSort();
        GoTo(0, column);
        return;
      }
    } catch (const RunTimeError& e) {
      Refresh();
      Told({e.what(), columns_[size_t(column)].heading});
      return;
    }
    sorted_ = column;
    descending_ = descending;
    ShowSort();
    Refresh();
    GoTo(0, column);
    Changed();
  });
  connect(this, &QTableView::doubleClicked, this, [this](const QModelIndex& index) {
    if (activated && !Editable(index.column())) activated(index.row());
  });
}

Grid::~Grid() { KeepWidths(); }

void Grid::Changed() {
  if (changed) changed();
}

void Grid::Told(const Refusal& refusal) {
  if (!refusal.text.empty()) services_.dialogs.Message(refusal.text, refusal.title);
}

bool Grid::AnyEditable() const {
  for (int i = 0; i < int(columns_.size()); ++i)
    if (Editable(i) && ColumnShown(i)) return true;
  return false;
}

// ---- Looks

void Grid::SetZoom(int percent) {
  zoom_ = std::clamp(percent, kLeastZoom, kMostZoom);
  ApplyZoom();
  ShowWidths();
}

void Grid::ApplyZoom() {
  QFont size = font();
  size.setPointSizeF(baseSize_ * zoom_ / 100);
  setFont(size);
  horizontalHeader()->setFont(size);
  verticalHeader()->setFont(size);
  const int height = QFontMetrics(size).height() + 6;
  verticalHeader()->setMinimumSectionSize(height);
  verticalHeader()->setDefaultSectionSize(height);
}

void Grid::SetWidths(const std::vector<int>& widths) {
  for (size_t i = 0; i < widths.size() && i < widths_.size(); ++i) widths_[i] = widths[i];
  ShowWidths();
}

// A hidden column has no width that could be set.
void Grid::ShowWidths() {
  settingWidths_ = true;
  for (size_t i = 0; i < widths_.size(); ++i)
    if (ColumnShown(int(i))) setColumnWidth(int(i), std::max(8, (widths_[i] * zoom_ + 50) / 100));
  settingWidths_ = false;
}

void Grid::KeepWidths() {
  if (!services_.widths || !widthsChanged_) return;
  widthsChanged_ = false;
  services_.widths->PutSetting(services_.section, services_.key, WidthsText(widths_));
}

void Grid::hideEvent(QHideEvent* event) {
  KeepWidths();
  QTableView::hideEvent(event);
}

void Grid::SetLocked(bool locked) {
  if (locked) EndEdit();
  locked_ = locked;
  setEditTriggers(locked ? QAbstractItemView::EditTriggers(NoEditTriggers)
                         : DoubleClicked | EditKeyPressed | AnyKeyPressed);
}

void Grid::SetSortable(bool sortable) {
  sortable_ = sortable;
  horizontalHeader()->setSectionsClickable(sortable ||
                                           selectionBehavior() == QAbstractItemView::SelectItems);
}

void Grid::ShowSort() {
  horizontalHeader()->setSortIndicatorShown(sorted_ >= 0);
  if (sorted_ >= 0)
    horizontalHeader()->setSortIndicator(sorted_,
                                         descending_ ? Qt::DescendingOrder : Qt::AscendingOrder);
}

void Grid::SetWholeRows(bool whole) {
  setSelectionBehavior(whole ? QAbstractItemView::SelectRows : QAbstractItemView::SelectItems);
}

void Grid::SetHeading(int column, const std::string& heading) {
  columns_[size_t(column)].heading = heading;
  model_->HeadingChanged(column);
}

void Grid::SetColumnShown(int column, bool shown) {
  settingWidths_ = true;
  setColumnHidden(column, !shown);
  ShowWidths();
}

// ---- Rows

void Grid::Refresh() { model_->Follow(); }
void Grid::RefreshRow(int row) { model_->RowChanged(row); }

void Grid::GoTo(int row, int column) {
  if (row < 0 || row >= model_->rowCount()) return;
  const QModelIndex index = model_->index(row, column);
  setCurrentIndex(index);
  scrollTo(index);
}

QRect Grid::SelectedCells() const {
  QRect cells;
  const QItemSelection ranges = selectionModel()->selection();
  for (const QItemSelectionRange& range : ranges)
    cells |= QRect(QPoint(range.left(), range.top()), QPoint(range.right(), range.bottom()));
  return cells;
}

RowBlock Grid::SelectedRows() const {
  const QRect cells = SelectedCells();
  if (cells.isNull()) return {};
  return {cells.top(), cells.bottom()};
}

void Grid::SelectRows(RowBlock rows) {
  if (rows.count() < 1 || rows.first < 0 || rows.last >= model_->rowCount()) return;
  selectionModel()->setCurrentIndex(model_->index(rows.first, std::max(0, CurrentColumn())),
                                    QItemSelectionModel::NoUpdate);
  selectionModel()->select(QItemSelection(model_->index(rows.first, 0),
                                          model_->index(rows.last, model_->columnCount() - 1)),
                           QItemSelectionModel::ClearAndSelect);
}

bool Grid::DeleteSelected() {
  if (!CanDelete() || !EndEdit()) return false;
  const RowBlock rows = SelectedRows();
  if (rows.count() < 1) return false;
  try {
    if (const auto refusal = source_.MayDelete(rows)) {
      Told(*refusal);
      return false;
    }
    if (asksToDelete_ && !AskDeleteRows(services_.dialogs, rows.count(),
                                        source_.RowName(rows.first), source_.RowName(rows.last)))
      return false;
    source_.DeleteRows(rows);
  } catch (const RunTimeError& e) {
    Refresh();
    Told({e.what(), "Delete Rows"});
    return false;
  }
  const int column = std::max(0, CurrentColumn());
  clearSelection();
  Refresh();
  GoTo(std::min(rows.first, model_->rowCount() - 1), column);
  Changed();
  return true;
}

// ---- Editing

QLineEdit* Grid::Editor() const { return static_cast<QLineEdit*>(editor_.data()); }

bool Grid::EndEdit() {
  if (!editor_ || !editing_.isValid()) return true;
  QWidget* editor = editor_;
  commitData(editor);
  if (held_) return false;
  closeEditor(editor, QAbstractItemDelegate::NoHint);
  return true;
}

void Grid::commitData(QWidget* editor) {
  // While a refusal is told the cell loses the focus and would commit again.
  if (held_ || editor != editor_ || !editing_.isValid()) return;
  const int row = editing_.row(), column = editing_.column();
  const std::string text = Editor()->text().toStdString();
  Refusal refusal;
  try {
    if (row >= source_.RowCount() || text == source_.Text(row, column)) return;
    const auto refused = source_.SetText(row, column, text);
    if (!refused) {
      Refresh();  // a text may change other cells, too
      Changed();
      return;
    }
    refusal = *refused;
  } catch (const RunTimeError& e) {
    refusal = {e.what(), columns_[size_t(column)].heading};
  }
  if (refusal.text.empty()) return;  // nothing to tell: the cell goes back to what it was
  held_ = true;
  const QPointer<Grid> self(this);
  Told(refusal);
  if (self) HoldEditor();
}

// Back to the refused cell once what is going on (a click elsewhere, say) has ended.
void Grid::HoldEditor() {
  QTimer::singleShot(0, this, [this] {
    if (editor_ && editing_.isValid()) {
      if (currentIndex() != editing_) setCurrentIndex(editing_);
      editor_->setFocus(Qt::OtherFocusReason);
      Editor()->selectAll();
    }
    held_ = false;
  });
}

void Grid::closeEditor(QWidget* editor, QAbstractItemDelegate::EndEditHint hint) {
  if (held_) return;
  if (editor == editor_) {
    editor_ = nullptr;
    editing_ = QPersistentModelIndex();
  }
  QTableView::closeEditor(editor, hint);
}

void Grid::Finish(Step step) {
  if (!EndEdit()) return;
  setFocus();
  Move(step);
}

bool Grid::Move(Step step) {
  const QModelIndex now = currentIndex();
  if (!now.isValid()) return false;
  int row = now.row(), column = now.column();
  const int rows = model_->rowCount(), columns = model_->columnCount();
  if (step == Step::kDown || step == Step::kUp) {
    row += step == Step::kDown ? 1 : -1;
    if (row < 0 || row >= rows) return false;
  } else {
    const int by = step == Step::kRight ? 1 : -1;
    do {
      column += by;
      if (column < 0 || column >= columns) {
        row += by;
        column = by > 0 ? 0 : columns - 1;
        if (row < 0 || row >= rows) return false;
      }
    } while (isColumnHidden(column));
  }
  setCurrentIndex(model_->index(row, column));
  return true;
}

void Grid::keyPressEvent(QKeyEvent* event) {
  const bool editing = AnyEditable();
  if (event->matches(QKeySequence::Copy)) {
    Copy();
    return;
  }
  if (event->matches(QKeySequence::Paste)) {
    Paste();
    return;
  }
  const Qt::KeyboardModifiers keys = event->modifiers() & ~Qt::KeypadModifier;
  switch (event->key()) {
    case Qt::Key_Delete:
      if (keys != Qt::NoModifier || !CanDelete()) break;
      DeleteSelected();
      return;
    case Qt::Key_Tab:
    case Qt::Key_Backtab:
      if (keys & Qt::ControlModifier)
        QAbstractScrollArea::focusNextPrevChild(event->key() == Qt::Key_Tab);
      return;
    case Qt::Key_Return:
    case Qt::Key_Enter:
      if (editing) {
        Move(keys & Qt::ShiftModifier ? Step::kUp : Step::kDown);
      } else if (activated && currentIndex().isValid()) {
        activated(CurrentRow());
      } else {
        event->ignore();
      }
      return;
    default: break;
  }
  // Without an editable cell typing is the form's: no search by the first letters, which would
  // ask the source for row after row.
  if (!editing && !event->text().isEmpty() && event->text().at(0).isPrint()) {
    event->ignore();
    return;
  }
  QTableView::keyPressEvent(event);
}

// Tab steps through the cells of a grid that can be edited, and leaves others at once.
bool Grid::focusNextPrevChild(bool next) {
  if (AnyEditable() && Move(next ? Step::kRight : Step::kLeft)) return true;
  return QAbstractScrollArea::focusNextPrevChild(next);
}

void Grid::contextMenuEvent(QContextMenuEvent* event) {
  const QModelIndex under = event->reason() == QContextMenuEvent::Mouse
                                ? indexAt(viewport()->mapFromGlobal(event->globalPos()))
                                : currentIndex();
  if (under.isValid() && !selectionModel()->isSelected(under)) setCurrentIndex(under);
  if (rightClicked) {
    if (under.isValid()) rightClicked(under.row());
    return;
  }
  auto* menu = new QMenu(this);
  menu->setObjectName("GridMenu");
  menu->setAttribute(Qt::WA_DeleteOnClose);
  menu->addActions(actions());
  const auto entry = [this, menu](const char* name, const char* caption, auto work) {
    QAction* action = menu->addAction(caption, this, work);
    action->setObjectName(name);
  };
  entry("GridCopy", "&Copy", [this] { Copy(); });
  if (AnyEditable()) entry("GridPaste", "&Paste", [this] { Paste(); });
  if (CanDelete()) entry("GridDelete", "&Delete Row/s", [this] { DeleteSelected(); });
  entry("GridSaveAs", "Save &As...", [this] { SaveAs(); });
  menu->popup(event->globalPos());
}

// ---- Text that leaves and enters

std::vector<std::string> Grid::Headings() const {
  std::vector<std::string> out;
  for (size_t i = 0; i < columns_.size(); ++i)
    if (ColumnShown(int(i))) out.push_back(ToQt(columns_[i].heading).simplified().toStdString());
  return out;
}

TextRows Grid::Texts(RowBlock rows) const {
  TextRows out;
  const int last = std::min(rows.last, source_.RowCount() - 1);
  for (int row = std::max(rows.first, 0); row <= last; ++row) {
    auto& cells = out.emplace_back();
    for (size_t i = 0; i < columns_.size(); ++i)
      if (ColumnShown(int(i))) cells.push_back(source_.Text(row, int(i)));
  }
  return out;
}

void Grid::Copy() {
  const QRect block = SelectedCells();
  if (block.isNull()) return;
  TextRows texts;
  try {
    for (int row = block.top(); row <= block.bottom() && row < source_.RowCount(); ++row) {
      auto& cells = texts.emplace_back();
      for (int column = block.left(); column <= block.right(); ++column)
        if (ColumnShown(column)) cells.push_back(source_.Text(row, column));
    }
  } catch (const RunTimeError& e) {
    Told({e.what(), "Copy"});
    return;
  }
  std::string text = TabText(texts);
  if (texts.size() == 1 && texts[0].size() == 1) text.pop_back();  // one cell: its text alone
  QGuiApplication::clipboard()->setText(ToQt(text));
}

// Cells that are there take the texts, from the cell in hand on; the first that is refused ends
// it, told, with the cells before it taken.
void Grid::Paste() {
  const QModelIndex at = currentIndex();
  if (!at.isValid() || !AnyEditable() || !EndEdit()) return;
  const TextRows texts = ParseTabText(QGuiApplication::clipboard()->text().toStdString());
  bool any = false;
  Refusal refusal;
  int row = at.row(), column = at.column();
  try {
    for (size_t r = 0; r < texts.size() && row < source_.RowCount(); ++r, ++row) {
      column = at.column();
      for (const std::string& text : texts[r]) {
        while (column < int(columns_.size()) && isColumnHidden(column)) ++column;
        if (column >= int(columns_.size())) break;
        if (Editable(column) && text != source_.Text(row, column)) {
          const GridColumn& rule = columns_[size_t(column)];
          const QString wanted = ToQt(text);
          const bool fits =
              (rule.limit <= 0 || wanted.size() <= rule.limit) &&
              (rule.typing.empty() ||
               QRegularExpression(QRegularExpression::anchoredPattern(ToQt(rule.typing)))
                   .match(wanted)
                   .hasMatch());
          const auto refused =
              fits ? source_.SetText(row, column, text)
                   : Refusal{"\"" + ForMessage(wanted) + "\" can't stand in this column",
                             ToQt(rule.heading).simplified().toStdString()};
          if (refused) {
            refusal = *refused;
            throw RunTimeError(kBadCall);
          }
          any = true;
        }
        ++column;
      }
    }
  } catch (const RunTimeError& e) {
    if (refusal.text.empty()) refusal = {e.what(), "Paste"};
  }
  Refresh();
  if (any) Changed();
  if (!refusal.text.empty()) {
    GoTo(row, column);
    Told(refusal);
  }
}

void Grid::SaveCsv(const std::string& hostPath) const {
  TextRows rows = Texts({0, source_.RowCount() - 1});
  rows.insert(rows.begin(), Headings());
  WriteHostFile(services_.files.io(), hostPath, ToAnsi(CsvText(rows)));
}

void Grid::SaveAs() {
  if (!EndEdit()) return;
  Modal<QFileDialog> dialog(this, "Save As", QString(), "Comma separated (*.csv);;All files (*)");
  dialog->setObjectName("GridSaveDialog");
  dialog->setAcceptMode(QFileDialog::AcceptSave);
  dialog->setDefaultSuffix("csv");
  if (dialog.Run() != QDialog::Accepted || dialog->selectedFiles().isEmpty()) return;
  const std::string path = dialog->selectedFiles().constFirst().toStdString();
  try {
    SaveCsv(path);
  } catch (const RunTimeError& e) {
    Told({std::string(e.what()) + "\n" + path, "Save As"});
  }
}

TextTable Grid::ToPrint(const std::string& heading) const {
  TextTable table{.layout = {.heading = heading}, .rows = {}};
  double total = 0;
  for (size_t i = 0; i < columns_.size(); ++i)
    if (ColumnShown(int(i))) total += widths_[i];
  double at = 0;
  for (size_t i = 0; i < columns_.size(); ++i) {
    if (!ColumnShown(int(i))) continue;
    table.layout.at.push_back(at / total);
    at += widths_[i];
  }
  table.layout.columns = Headings();
  table.rows = Texts({0, source_.RowCount() - 1});
  return table;
}

}  // namespace kora
