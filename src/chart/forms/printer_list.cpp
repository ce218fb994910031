#include "chart/forms/printer_list.h"

#include <QComboBox>

#include "platform/qt/form_parts.h"
#include "platform/qt/qt_printer.h"

namespace kora {

QComboBox* NewPrinterList(QWidget* form, const Printer& printer) {
  auto* list = new QComboBox(form);
  list->setObjectName("Combo1");
  for (const std::string& name : printer.DeviceNames()) list->addItem(ToQt(name));
  int chosen = list->findText(ToQt(printer.DeviceName()));
  if (chosen < 0) chosen = list->findText(ToQt(QtPrinter::kPdfPrinter));
  list->setCurrentIndex(chosen);
  return list;
}

}  // namespace kora
