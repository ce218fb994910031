#include "looks/forms/Scales.h"

#include <QGridLayout>
#include <QLabel>
#include <QLineEdit>
#include <QLocale>
#include <QPushButton>
#include <cmath>

#include "base/runtime_error.h"
#include "base/text.h"
#include "looks/look_settings.h"
#include "platform/qt/form_parts.h"

namespace kora {
namespace {

constexpr double kLargestPrice = 1e9;

}  // namespace

Scales::Scales(ScalesServices services, QWidget* parent)
    : QDialog(parent), services_(std::move(services)) {
  setObjectName("Scales");
  setWindowTitle("Scales");
  const NameRec& record = services_.current.Rec;
  const bool any = services_.current.NameRecNo > 0;
  auto* grid = new QGridLayout(this);
  const std::string title =
      FromAnsi(record.Code.trimmed()) + "  " + FromAnsi(Trim(record.Name.trimmed()));
  auto* label1 = NewLabel(this, any ? ToQt(title) : QString("No chart is selected"));
  label1->setObjectName("Label1");
  label1->setTextFormat(Qt::PlainText);
  grid->addWidget(label1, 0, 0, 1, 3);

  const char* captions[] = {"&Base", "&Top", "&PF Inc"};
  const float values[] = {record.Base, record.Top, record.PFInc};
  for (int i = 0; i < 3; ++i) {
    text_[i] = NewField(this, QString("Text%1").arg(i + 1), 10, 20);
    if (any) text_[i]->setText(ToQt(ScaleText(values[i])));
    text_[i]->setEnabled(any);
    grid->addWidget(NewLabel(this, captions[i], text_[i]), i + 1, 0);
    grid->addWidget(text_[i], i + 1, 1);
  }
  grid->setColumnStretch(2, 1);
  AddOkCancel(this, grid, [this] { Save(); })->setEnabled(any);
  FocusField(text_[0]);
}

void Scales::Save() {
  double values[3] = {};
  for (int i = 0; i < 3; ++i) {
    const QString typed = text_[i]->text().trimmed();
    bool number = true;
    if (!typed.isEmpty()) values[i] = QLocale::c().toDouble(typed, &number);
    if (number && std::abs(values[i]) <= kLargestPrice && (i < 2 || values[i] >= 0)) continue;
    services_.dialogs.Message(typed.toStdString() + " is not a price", "Scales");
    return FocusField(text_[i]);
  }
  if (values[0] != 0 && values[1] != 0 && values[1] <= values[0]) {
    services_.dialogs.Message("Top must be above Base", "Scales");
    return FocusField(text_[1]);
  }
  try {
    SaveScales(services_.files, services_.dataPath, services_.current,
               text_[0]->text().toStdString(), text_[1]->text().toStdString(),
               text_[2]->text().toStdString());
  } catch (const RunTimeError& e) {
    services_.dialogs.Message(NotSavedText(e), kNotSavedTitle);
    return;
  }
  accept();
  if (services_.saved) services_.saved();
}

}  // namespace kora
