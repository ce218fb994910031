#include "indicators/forms/OscFrm.h"

#include <QGridLayout>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>

#include "base/numbers.h"
#include "base/text.h"
#include "indicators/compare_file.h"
#include "platform/qt/form_parts.h"

namespace kora {
namespace {

constexpr int kFieldLimit = 4, kCompareLimit = 100;

}  // namespace

OscFrm::OscFrm(OscFrmServices services, std::string_view oscCode, QWidget* parent)
    : QDialog(parent), services_(std::move(services)) {
  setObjectName("OscFrm");
  auto* grid = new QGridLayout(this);
  if (services_.chartStyle == Style::kPointFigure) {
    setWindowTitle("Point and Figure");
    setMinimumWidth(fontMetrics().averageCharWidth() * 36);  // room for the title
    fields_.push_back(
        AddField("Text1", "Box Value ", Str(services_.boxValue), kFieldLimit, kFieldLimit));
  } else if ((box_ = FindOscBox(oscCode))) {
    setWindowTitle(box_->boxCaption);
    FillOscDefaults(services_.settings.osc, services_.chartPeriod);
    for (const OscField& field : box_->fields) {
      const std::int16_t period = services_.settings.osc[field.key].For(services_.chartPeriod);
      fields_.push_back(AddField(QString("Text%1").arg(fields_.size() + 1), field.label,
                                 Str(std::int32_t(period)), kFieldLimit, kFieldLimit));
    }
    if (box_->compares)
      compare_ =
          AddField("Text5", kCompareLabel, services_.settings.osc.CompFile, 36, kCompareLimit);
  }
  grid->setColumnStretch(1, 1);
  AddOkCancel(this, grid, [this] { Save(); });
  if (!fields_.empty()) FocusField(fields_[0]);
}

QLineEdit* OscFrm::AddField(const QString& name, const QString& label, const std::string& value,
                            int columns, int limit) {
  auto* grid = static_cast<QGridLayout*>(layout());
  // What stands in the box is shown whole, however long: a cut number would be another one.
  const QString text = ToQt(value);
  QLineEdit* field = NewField(this, name, columns, std::max(limit, int(text.size())));
  field->setText(text);
  field->installEventFilter(this);
  const int row = grid->rowCount();
  auto* caption = NewLabel(this, label, field);
  caption->setTextFormat(Qt::PlainText);
  grid->addWidget(caption, row, 0);
  if (columns > kFieldLimit)
    grid->addWidget(field, row, 1);
  else
    grid->addWidget(field, row, 1, Qt::AlignLeft);
  return field;
}

// Enter goes on to the next box, and from the last to the button; a box that is entered has its
// text selected, by the mouse too.
bool OscFrm::eventFilter(QObject* object, QEvent* event) {
  auto* field = qobject_cast<QLineEdit*>(object);
  if (field && event->type() == QEvent::KeyPress) {
    const int key = static_cast<QKeyEvent*>(event)->key();
    if (key == Qt::Key_Return || key == Qt::Key_Enter) {
      focusNextChild();
      return true;
    }
  }
  // After the click has put its cursor.
  if (field && event->type() == QEvent::FocusIn)
    QMetaObject::invokeMethod(field, &QLineEdit::selectAll, Qt::QueuedConnection);
  return QDialog::eventFilter(object, event);
}

void OscFrm::Save() {
  if (services_.chartStyle == Style::kPointFigure ? !SaveBoxValue() : !SavePeriods()) return;
  accept();
  if (services_.redraw) services_.redraw();
}

bool OscFrm::SaveBoxValue() {
  const auto value = ReadBoxValue(services_.dialogs, fields_[0]->text().toStdString());
  if (!value) {
    FocusField(fields_[0]);
    return false;
  }
  services_.boxValue = *value;
  return true;
}

bool OscFrm::SavePeriods() {
  if (!box_) return true;
  std::vector<std::string> typed;
  for (const QLineEdit* field : fields_) typed.push_back(field->text().toStdString());
  OscSettings entered = services_.settings.osc;
  size_t refused = 0;
  if (!ReadOscFields(*box_, typed, services_.chartPeriod, entered, refused)) {
    services_.dialogs.Message(kOscPeriodMessage, kOscPeriodTitle);
    FocusField(fields_[refused]);
    return false;
  }
  if (compare_) {
    entered.CompFile = std::string(Trim(compare_->text().toStdString()));
    const CompareFileAnswer answer =
        TestCompareFile(services_.files, services_.dialogs, entered.CompFile);
    if (answer == CompareFileAnswer::kGiveUp) {
      reject();
      return false;
    }
    if (answer == CompareFileAnswer::kCorrect ||
        ValidateCompareFile(services_.files, services_.dialogs, entered.CompFile).empty()) {
      FocusField(compare_);
      return false;
    }
  }
  services_.settings.osc = entered;
  return true;
}

}  // namespace kora
