#include "platform/qt/form_style.h"

#include <QApplication>
#include <QPainter>
#include <QStyleOption>

namespace kora {
namespace {

constexpr const char* kOwnStyle = "fusion";

bool IsDark(const QPalette& colours) { return colours.color(QPalette::Window).lightness() < 128; }

}  // namespace

FormStyle::FormStyle() : QProxyStyle(kOwnStyle) {}

void FormStyle::drawPrimitive(PrimitiveElement element, const QStyleOption* option,
                              QPainter* painter, const QWidget* widget) const {
  QProxyStyle::drawPrimitive(element, option, painter, widget);
  const bool round = element == PE_IndicatorRadioButton;
  const bool box = element == PE_IndicatorCheckBox || element == PE_IndicatorItemViewItemCheck;
  if ((!round && !box) || !IsDark(option->palette)) return;
  painter->save();
  painter->setRenderHint(QPainter::Antialiasing);
  QColor rim = option->palette.color(QPalette::WindowText);
  rim.setAlphaF(option->state & State_Enabled ? 0.6f : 0.3f);
  painter->setPen(rim);
  painter->setBrush(Qt::NoBrush);
  const QRectF place = QRectF(option->rect).adjusted(0.5, 0.5, -0.5, -0.5);
  if (round)
    painter->drawEllipse(place);
  else
    painter->drawRoundedRect(place, 1, 1);
  painter->restore();
}

QIcon FormStyle::standardIcon(StandardPixmap which, const QStyleOption* option,
                              const QWidget* widget) const {
  if (which != SP_ToolBarHorizontalExtensionButton)
    return QProxyStyle::standardIcon(which, option, widget);
  constexpr int kSize = 32;
  QPixmap arrows(kSize, kSize);
  arrows.fill(Qt::transparent);
  QPainter painter(&arrows);
  painter.setRenderHint(QPainter::Antialiasing);
  const QPalette colours = widget ? widget->palette() : QApplication::palette();
  painter.setPen(QPen(colours.color(QPalette::ButtonText), 3));
  for (const int x : {7, 17}) painter.drawPolyline(QPolygon({{x, 8}, {x + 8, 16}, {x, 24}}));
  return QIcon(arrows);
}

void InstallFormStyle() {
  if (QApplication::style()->name() == kOwnStyle) QApplication::setStyle(new FormStyle);
}

}  // namespace kora
