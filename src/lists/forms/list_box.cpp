#include "lists/forms/list_box.h"

#include <QAction>
#include <QMenu>
#include <QResizeEvent>
#include <QStyledItemDelegate>
#include <algorithm>

#include "base/home_lock.h"
#include "base/numbers.h"
#include "base/runtime_error.h"
#include "platform/dialogs.h"

namespace kora {

namespace {

constexpr int kNameRole = Qt::UserRole;

// The name beside the code: the item's text stays the code, by which one types to find it.
class CodeWithName : public QStyledItemDelegate {
 public:
  using QStyledItemDelegate::QStyledItemDelegate;

 protected:
  void initStyleOption(QStyleOptionViewItem* option, const QModelIndex& index) const override {
    QStyledItemDelegate::initStyleOption(option, index);
    const QString name = index.data(kNameRole).toString();
    if (!name.isEmpty()) option->text += "\t" + name;
  }
};

}  // namespace

bool TellErrors(Dialogs& dialogs, const char* title, const std::function<void()>& work) {
  try {
    work();
    return true;
  } catch (const HomeIsHeld& e) {
    dialogs.Message(e.what(), title);
    return false;
  } catch (const RunTimeError& e) {
    dialogs.Message("There is an unexpected error number " + Str(e.number()) + "\n" + e.what(),
                    title);
    return false;
  }
}

CodeList::CodeList(const char* name, QWidget* parent) : QListWidget(parent) {
  setObjectName(name);
  setSelectionMode(ExtendedSelection);
  setUniformItemSizes(true);
  setItemDelegate(new CodeWithName(this));
  setMinimumHeight(fontMetrics().height() * 12);
  setMinimumWidth(fontMetrics().averageCharWidth() * 20);
}

void CodeList::Show(const std::vector<std::string>& codes, const CodeNames& names) {
  clear();
  for (const std::string& code : codes) Append(code, names);
}

void CodeList::Append(const std::string& code, const CodeNames& names) {
  auto* item = new QListWidgetItem(QString::fromStdString(code));
  if (const auto name = names.find(code); name != names.end()) {
    item->setData(kNameRole, QString::fromStdString(name->second));
    item->setToolTip(QString::fromStdString(name->second));
  }
  addItem(item);
}

std::vector<size_t> CodeList::Selected() const {
  std::vector<size_t> places;
  for (const QModelIndex& index : selectionModel()->selectedIndexes())
    places.push_back(size_t(index.row()));
  std::sort(places.begin(), places.end());
  return places;
}

std::string CodeList::CodeAt(size_t place) const { return item(int(place))->text().toStdString(); }

void CodeList::SelectOnly(size_t place) {
  setCurrentRow(int(place), QItemSelectionModel::ClearAndSelect);
  scrollToItem(item(int(place)));
}

void CodeList::SetColumns(int columns) {
  columns_ = columns;
  setFlow(TopToBottom);
  setWrapping(columns > 1);
  setResizeMode(columns > 1 ? Adjust : Fixed);
  FitColumns();
}

void CodeList::resizeEvent(QResizeEvent* event) {
  QListWidget::resizeEvent(event);
  FitColumns();
}

void CodeList::FitColumns() {
  const int width = columns_ > 1 ? viewport()->width() / columns_ : 0;
  const QSize grid(width, width > 0 ? fontMetrics().height() * 5 / 4 : 0);
  if (gridSize() != grid) setGridSize(width > 0 ? grid : QSize());
}

void AddEditOptions(CodeList* list, const char* deleteCaption, std::function<void()> deleteSelected,
                    std::function<void()> deleteAll) {
  auto* menu = new QMenu("Edit Options", list);
  menu->setObjectName("slmnuEO");
  auto* del = menu->addAction(deleteCaption, list, std::move(deleteSelected));
  del->setObjectName("slmnuDel");
  del->setShortcut(QKeySequence::Delete);
  del->setShortcutContext(Qt::WidgetShortcut);
  list->addAction(del);  // for its shortcut
  menu->addAction("&Delete All Items", list, std::move(deleteAll))->setObjectName("SlmnuDAI");
  list->setContextMenuPolicy(Qt::CustomContextMenu);
  QObject::connect(list, &QWidget::customContextMenuRequested, menu,
                   [list, menu](QPoint at) { menu->popup(list->viewport()->mapToGlobal(at)); });
}

}  // namespace kora
