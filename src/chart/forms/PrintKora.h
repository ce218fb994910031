#pragma once

#include <QDialog>
#include <functional>
#include <optional>

#include "chart/forms/print_services.h"

class QCheckBox;
class QComboBox;
class QLineEdit;
class QPushButton;
class QSpinBox;

namespace kora {

// What the user answered.
struct PrintChoice {
  bool PrintCancelled = true;
  std::int16_t PrintCopies = 1;
  std::string pdfFile;  // DOS path; in: what is proposed
  // Asks for a file: a host path, nothing when cancelled. Empty: the platform's own dialog.
  std::function<std::optional<std::string>(const std::string& hostPath)> pickPdf = {};
};

// How many copies, and on which printer; for a PDF, into which file. Closed by its first button
// it has set the printer in use and `choice`; otherwise choice.PrintCancelled is true and the
// rest as it was.
class PrintKora : public QDialog {
 public:
  PrintKora(const PrintServices& services, PrintChoice& choice, QWidget* parent);
  void reject() override;

 private:
  bool IsPdf() const;
  void PrinterChosen();
  void Browse();
  void Proceed();

  PrintServices services_;
  PrintChoice& choice_;
  QComboBox* combo1_;
  QSpinBox* text1_;
  QLineEdit* text2_;
  QPushButton* browse_;
  QCheckBox* dark_;
};

}  // namespace kora
