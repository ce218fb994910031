#pragma once

#include <QDialog>
#include <functional>

#include "lists/chart_list.h"
#include "lists/forms/list_box.h"
#include "platform/dialogs.h"
#include "platform/settings_file.h"
#include "settings/settings.h"

class QComboBox;
class QLineEdit;
class QPushButton;

namespace kora {

// Services of the forms that edit the chart lists.
struct ListFormServices {
  const Files& files;
  Dialogs& dialogs;
  const Settings& settings;
  SettingsFile& user;  // the per-user store: names of the lists
  // Shows the codes of the name file over a form; each that is selected there is handed back.
  std::function<void(QWidget* over, std::function<void(const std::string& code)> select)>
      openCodes = {};
};

// "Chart Lists": edits one list.
class SubList : public QDialog {
 public:
  SubList(ListFormServices services, QWidget* parent);

  void reject() override;

 protected:
  bool eventFilter(QObject* object, QEvent* event) override;
  bool event(QEvent* event) override;

 private:
  void ComboList();
  void ShowList();
  void StockList();
  // Reads again what another program changed meanwhile.
  void LookAgain();
  void ListChosen(int index);
  void FindWhileTyping(const QString& typed);
  void Add();
  void AddTyped();
  void OpenCodes();
  void AddAt(size_t place);
  void DeleteSelected();
  void DeleteAll();
  void Edited();
  bool Save();
  // False when the changed list could not be saved, so that nothing is left.
  bool LeaveList();
  std::int16_t ListNo() const { return std::int16_t(list_ + kFirstChartList); }

  ListFormServices services_;
  QComboBox* combo1_;
  CodeList *list1_, *list2_;
  QLineEdit* text2_;
  QPushButton *add_, *del_, *save_, *select_;
  int list_ = -1;  // of the combo, from 0
  ListCodes codes_, nameCodes_;
  FileStamp listStamp_, namesStamp_;  // of the files that they were read from
  CodeNames names_;
  bool changed_ = false;
};

}  // namespace kora
