#pragma once

#include <QPointer>
#include <functional>
#include <string>

#include "lists/text_print_out.h"
#include "shell/session.h"

class QDialog;
class QWidget;

namespace kora {

class CodeSelection;

// What the forms of price files need of the main window.
struct DataDeskHooks {
  std::function<void(const TextTable&, QWidget* over)> printTable;
  std::function<void(QWidget* over)> pageSetup;
  // Asks for the size of forms with tables; percent.
  std::function<int(QWidget* over)> changeSize;
  // Charts read the prices again.
  std::function<void()> pricesChanged;
};

// The forms that show a price file and correct it by hand. It lives as long as the main window.
class DataDesk {
 public:
  DataDesk(Session& session, QWidget* over, DataDeskHooks hooks)
      : session_(session), over_(over), hooks_(std::move(hooks)) {}

  void OpenData();  // EnterCode, which opens DataForm
  // EnterCode over the editor of chart lists, which takes each code that is selected.
  void OpenCodes(QWidget* over, std::function<void(const std::string& code)> select);

 private:
  void View(const CodeSelection& selection, QWidget* over);

  Session& session_;
  QWidget* over_;
  DataDeskHooks hooks_;
  int lastIndex_ = 0;  // of the list of codes
  QPointer<QDialog> codes_, data_;
};

}  // namespace kora
