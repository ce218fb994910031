#include "platform/qt/form_style.h"

#include <gtest/gtest.h>

#include <QCheckBox>
#include <QImage>
#include <QRadioButton>

namespace kora {
namespace {

// How far the brightest pixel of the mark without a text stands out from the ground.
int Rim(QAbstractButton& button, QStyle& style, const QColor& ground) {
  QPalette colours(ground);
  colours.setColor(QPalette::Base, ground.darker(150));
  colours.setColor(QPalette::WindowText, ground.lightness() < 128 ? Qt::white : Qt::black);
  button.setStyle(&style);
  button.setPalette(colours);
  button.setAutoFillBackground(true);
  button.resize(button.sizeHint());
  const QImage shown = button.grab().toImage();
  int most = 0;
  for (int y = 0; y < shown.height(); ++y)
    for (int x = 0; x < shown.width(); ++x)
      most = std::max(most, qGray(shown.pixel(x, y)) - qGray(ground.rgb()));
  return most;
}

TEST(FormStyle, BoxesAndButtonsHaveARimOnADarkGround) {
  FormStyle style;
  QCheckBox box;
  QRadioButton choice;
  for (QAbstractButton* button : std::initializer_list<QAbstractButton*>{&box, &choice}) {
    const int dark = Rim(*button, style, QColor(45, 45, 45));
    EXPECT_GT(dark, 60);
    button->setEnabled(false);
    EXPECT_LT(Rim(*button, style, QColor(45, 45, 45)), dark) << "fainter where it can't be used";
    button->setEnabled(true);
  }
}

TEST(FormStyle, TheArrowsOfAToolBarHaveTheColourOfItsTexts) {
  FormStyle style;
  QWidget bar;
  for (const QColor text : {QColor(Qt::white), QColor(Qt::black)}) {
    QPalette colours;
    colours.setColor(QPalette::ButtonText, text);
    bar.setPalette(colours);
    const QImage arrows =
        style.standardIcon(QStyle::SP_ToolBarHorizontalExtensionButton, nullptr, &bar)
            .pixmap(32, 32)
            .toImage();
    int drawn = 0;
    for (int y = 0; y < arrows.height(); ++y)
      for (int x = 0; x < arrows.width(); ++x)
        drawn += arrows.pixelColor(x, y).alpha() > 250 && arrows.pixelColor(x, y) == text;
    EXPECT_GT(drawn, 20);
  }
}

TEST(FormStyle, OnALightGroundTheyAreAsTheyWere) {
  FormStyle style;
  QCheckBox box;
  QPalette light(QColor(239, 239, 239));
  box.setPalette(light);
  box.resize(box.sizeHint());
  const QImage before = box.grab().toImage();
  box.setStyle(&style);
  EXPECT_EQ(box.grab().toImage(), before);
}

}  // namespace
}  // namespace kora
