#pragma once

#include <QDialog>
#include <QPointer>
#include <functional>
#include <vector>

#include "adjust/issue_adjustment.h"
#include "store/name_file.h"

class QLineEdit;
class QRadioButton;

namespace kora {

struct AdjustFormServices {
  AdjustServices adjust;
  CurrentName& current;  // takes the code and the price file of each security stepped to
  std::function<void()> disableMenus, enableMenus;
  std::function<void()> adjusted;  // prices of the data folder have changed
};

// "Adjustments for Issues": the security and the kind of issue. Main menus are off while it is
// open.
class Adjust : public QDialog {
 public:
  Adjust(AdjustFormServices services, QWidget* parent);

  // Reads the name file and shows its first share or index. Error 53, 75, 76 where the file can't
  // be read.
  void Fill();

  void done(int result) override;

 protected:
  bool event(QEvent* event) override;

 private:
  void Show(size_t place);
  void Step(int by);
  void OpenKind(int option);
  std::string Code() const;

  AdjustFormServices services_;
  QLineEdit *text7_, *text8_;
  QRadioButton* options_[6];
  std::vector<NameRec> names_;  // of RecType 4 and 5, in the order of the file
  FileStamp stamp_;
  size_t place_ = 0;
  QPointer<QDialog> open_;
  bool menusOff_ = false;
};

}  // namespace kora
