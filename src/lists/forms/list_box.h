#pragma once

#include <QListWidget>
#include <functional>
#include <map>
#include <string>
#include <vector>

// What the forms of the chart lists share.

namespace kora {

class Dialogs;

// Runs `work`; a run-time error is told under `title`. False then.
bool TellErrors(Dialogs& dialogs, const char* title, const std::function<void()>& work);

// Names by code, shown beside the codes.
using CodeNames = std::map<std::string, std::string, std::less<>>;

// A list of codes in which several can be selected.
class CodeList : public QListWidget {
 public:
  CodeList(const char* name, QWidget* parent);

  void Show(const std::vector<std::string>& codes, const CodeNames& names);
  void Append(const std::string& code, const CodeNames& names);
  // Places of the selected items, in list order.
  std::vector<size_t> Selected() const;
  std::string CodeAt(size_t place) const;
  // One item selected and in sight.
  void SelectOnly(size_t place);
  // Shows the codes side by side in so many columns.
  void SetColumns(int columns);

 protected:
  void resizeEvent(QResizeEvent* event) override;

 private:
  void FitColumns();
  int columns_ = 1;
};

// "Edit Options" over a list, by right click and menu key: delete what is selected (Del too),
// delete all.
void AddEditOptions(CodeList* list, const char* deleteCaption, std::function<void()> deleteSelected,
                    std::function<void()> deleteAll);

}  // namespace kora
