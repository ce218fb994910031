#include "platform/qt/chart_font.h"

#include <QFontDatabase>
#include <QStringList>
#include <algorithm>

#include "platform/qt/to_qt.h"
#include "platform/text_metrics.h"

namespace kora {

bool CanBeFace(const SurfaceFont& font) {
  if (font.name.size() > 200 || !(font.size >= 1 && font.size <= 2048)) return false;
  return std::none_of(font.name.begin(), font.name.end(),
                      [](char c) { return static_cast<unsigned char>(c) < 32 || c == 127; });
}

ChartFont MakeChartFont(const SurfaceFont& of) {
  const QString name = ToQt(of.name);
  ChartFont made;
  made.standard = HasStandardMetrics(of) || !QFontDatabase::hasFamily(name);
  QFont& font = made.font;
  if (made.standard) {
    font.setFamilies(QStringList{"Liberation Sans", "Arial", "Helvetica", "sans-serif"});
  } else {
    font.setFamilies(QStringList{name, "Liberation Sans", "Arial"});
  }
  font.setStyleHint(QFont::SansSerif);
  font.setHintingPreference(QFont::PreferNoHinting);
  font.setBold(of.bold);
  font.setItalic(of.italic);
  font.setKerning(false);
  font.setPointSizeF(of.size);
  return made;
}

}  // namespace kora
