#pragma once

class QComboBox;
class QWidget;

namespace kora {

class Printer;

// "Combo1", the printers of the machine, with the one in use chosen; where there is none, or
// it was taken away, the one that makes a PDF.
QComboBox* NewPrinterList(QWidget* form, const Printer& printer);

}  // namespace kora
