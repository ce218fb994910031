// Draws the icon in the sizes of a theme: draw_icons KORA.SVG KORA-SMALL.SVG FOLDER makes
// FOLDER/16.png and so on.

#include <QDir>
#include <QImage>
#include <QPainter>
#include <QSvgRenderer>
#include <cstdio>

int main(int argc, char** argv) {
  if (argc != 4) return 2;
  QSvgRenderer large(QString::fromLocal8Bit(argv[1])), small(QString::fromLocal8Bit(argv[2]));
  const QDir folder(QString::fromLocal8Bit(argv[3]));
  for (const int size : {16, 22, 24, 32, 48, 64, 128, 256}) {
    QImage image(size, size, QImage::Format_ARGB32_Premultiplied);
    image.fill(Qt::transparent);
    QPainter painter(&image);
    // The small drawing stands on whole dots, once or twice as large, in the middle.
    const int side = size < 48 ? 16 * (size / 16) : size;
    const int edge = (size - side) / 2;
    (size < 48 ? small : large).render(&painter, QRectF(edge, edge, side, side));
    painter.end();
    const QString file = folder.filePath(QString("%1.png").arg(size));
    if (image.save(file)) continue;
    std::fprintf(stderr, "can't write %s\n", qPrintable(file));
    return 1;
  }
  return 0;
}
