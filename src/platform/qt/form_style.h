#pragma once

#include <QProxyStyle>

namespace kora {

// The style of the forms where the desktop brings none of its own: its boxes to tick and buttons to
// choose have a rim that is seen on a dark ground, and the arrows to what a tool bar has no room for
// the colour of texts.
class FormStyle : public QProxyStyle {
 public:
  FormStyle();
  void drawPrimitive(PrimitiveElement element, const QStyleOption* option, QPainter* painter,
                     const QWidget* widget) const override;
  QIcon standardIcon(StandardPixmap which, const QStyleOption* option,
                     const QWidget* widget) const override;
};

// Takes it where the desktop brings none. Needs an application.
void InstallFormStyle();

}  // namespace kora
