#pragma once

#include <QDialog>
#include <functional>

#include "lists/forms/list_box.h"
#include "maintenance/code_selection.h"

class QLabel;
class QLineEdit;

namespace kora {

struct EnterCodeServices {
  const Files& files;
  const std::string& dataPath;
  Dialogs& dialogs;
  int& lastIndex;  // of the list, for the next time
  // `Command1`: shows the price file of the security over the form. Null when the form serves the
  // chart list editor.
  std::function<void(const CodeSelection&, QWidget* over)> view = {};
  // `Command3`: adds the code to the list that is being edited.
  std::function<void(const std::string& code)> select = {};
};

// "Code Selection": chooses a security by its code.
class EnterCode : public QDialog {
 public:
  EnterCode(EnterCodeServices services, QWidget* parent);

  // Reads the name file. Its errors.
  void Fill();

 protected:
  bool event(QEvent* event) override;
  bool eventFilter(QObject* object, QEvent* event) override;

 private:
  void ShowCodes(int index);
  void CodeChosen(int index);
  void CodeTyped();
  void ShowChoice();
  void View();
  void Select();

  EnterCodeServices services_;
  CodeSelection selection_;
  CodeList* list1_;
  QLineEdit* getCode_;
  QLabel *label4_, *label3_;
};

}  // namespace kora
