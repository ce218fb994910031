#include "platform/qt/accessible_names.h"

#include <QAccessibleWidget>
#include <QComboBox>
#include <QLabel>

namespace kora {
namespace {

QString WithoutMnemonic(QString text) {
  const qsizetype at = text.indexOf('&');
  return at < 0 ? text : text.remove(at, 1);
}

QString LabelOf(const QWidget* control) {
  const QWidget* form = control->parentWidget();
  if (!form) return {};
  for (const QLabel* label : form->window()->findChildren<QLabel*>())
    if (label->buddy() == control) return WithoutMnemonic(label->text());
  return {};
}

class ComboBoxNode : public QAccessibleWidget {
 public:
  explicit ComboBoxNode(QComboBox* box)
      : QAccessibleWidget(box, QAccessible::ComboBox), box_(box) {}

  QString text(QAccessible::Text what) const override {
    switch (what) {
      case QAccessible::Name:
        return box_->accessibleName().isEmpty() ? LabelOf(box_) : box_->accessibleName();
      case QAccessible::Value: return box_->currentText();
      default: return QAccessibleWidget::text(what);
    }
  }
  QStringList actionNames() const override {
    return QStringList{showMenuAction(), pressAction()} + QAccessibleWidget::actionNames();
  }
  void doAction(const QString& action) override {
    if (action == showMenuAction() || action == pressAction())
      box_->showPopup();
    else
      QAccessibleWidget::doAction(action);
  }

 private:
  QComboBox* box_;
};

QAccessibleInterface* Make(const QString&, QObject* object) {
  auto* box = qobject_cast<QComboBox*>(object);
  return box ? new ComboBoxNode(box) : nullptr;
}

}  // namespace

void InstallAccessibleNames() { QAccessible::installFactory(Make); }

}  // namespace kora
