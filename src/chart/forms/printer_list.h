#pragma once

class QComboBox;
class QWidget;

namespace kora {

class Printer;

// "Combo1", the printers of the machine, with the one in use chosen; where there is none, the
// one that makes a PDF, which needs no other.
QComboBox* NewPrinterList(QWidget* form, const Printer& printer);

}  // namespace kora
