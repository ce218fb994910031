#include "shell/forms/AbtKora.h"

#include <QLabel>
#include <QPushButton>
#include <QVBoxLayout>

#include "base/version.h"
#include "platform/qt/to_qt.h"

namespace kora {

AbtKora::AbtKora(QWidget* parent) : QDialog(parent) {
  setObjectName("AbtKora");
  setWindowTitle("About KORA");
  auto* column = new QVBoxLayout(this);
  const QString version = "* * Version " + ToQt(kVersion) + " * *     for Windows 95/98 or later ";
  const QString lines[] = {
      version, "KORA software is designed to be used as a tool only.",
      "Any information provided by the software is not suitable to be acted on as investment "
      "advice.",
      "We recommend that you obtain independent advice from your broker or investment advisor "
      "before making any investment decisions relying on the information."};
  int index = 0;
  for (const QString& line : lines) {
    auto* label = new QLabel(line, this);
    label->setObjectName(QString("Label1(%1)").arg(index++));
    label->setTextFormat(Qt::PlainText);
    label->setAlignment(Qt::AlignHCenter);
    label->setWordWrap(index > 1);
    label->setMinimumWidth(fontMetrics().averageCharWidth() * 55);
    column->addWidget(label);
  }
  QFont bold = font();
  bold.setBold(true);
  findChild<QLabel*>("Label1(0)")->setFont(bold);
  auto* ok = new QPushButton("OK", this);
  ok->setObjectName("Command1");
  ok->setDefault(true);
  connect(ok, &QPushButton::clicked, this, &QDialog::accept);
  column->addSpacing(fontMetrics().height() / 2);
  column->addWidget(ok, 0, Qt::AlignHCenter);
}

}  // namespace kora
