#include "chartwindow/forms/KoraScroll.h"

#include <QHBoxLayout>
#include <QLabel>
#include <QPushButton>
#include <QSlider>
#include <QVBoxLayout>

#include "platform/qt/to_qt.h"

namespace kora {

KoraScroll::KoraScroll(ChartScroll& scroll, QWidget* parent)
    : QDialog(parent),
      scroll_(scroll),
      hScroll1_(new QSlider(Qt::Horizontal, this)),
      label1_(new QLabel(this)) {
  setObjectName("KoraScroll");
  setWindowTitle("Scroll Forwards / Backwards");
  hScroll1_->setObjectName("HScroll1");
  hScroll1_->setAccessibleName("Record at which the chart ends");
  hScroll1_->setRange(1, scroll.Maximum());
  hScroll1_->setPageStep(20);
  hScroll1_->setValue(scroll.Value());
  label1_->setObjectName("Label1");
  auto* label2 = new QLabel("&Stop chart at ", this);
  label2->setObjectName("Label2");
  label2->setBuddy(hScroll1_);
  auto* ok = new QPushButton("OK", this);
  ok->setObjectName("Command1");
  ok->setDefault(true);

  auto* date = new QHBoxLayout;
  date->addWidget(label2);
  date->addWidget(label1_, 1);
  date->addWidget(ok);
  auto* rows = new QVBoxLayout(this);
  rows->addWidget(hScroll1_);
  rows->addLayout(date);
  setMinimumWidth(fontMetrics().averageCharWidth() * 70);

  connect(hScroll1_, &QSlider::valueChanged, this, [this] { Show(); });
  connect(ok, &QPushButton::clicked, this, [this] {
    scroll_.Accept();
    accept();
  });
  hScroll1_->setFocus();
  Show();
}

void KoraScroll::Show() {
  scroll_.SetValue(hScroll1_->value());
  label1_->setText(ToQt(scroll_.DateText()));
}

}  // namespace kora
