#include "platform/qt/png.h"

#include <QtEndian>
#include <array>
#include <cstring>
#include <optional>
#include <vector>

#include "base/runtime_error.h"

namespace kora {
namespace {

// Flat rows pack nearly as well by the quick search as by the thorough one.
constexpr int kCompression = 2;

class Crc {
 public:
  Crc() {
    for (quint32 n = 0; n < 256; ++n) {
      quint32 c = n;
      for (int bit = 0; bit < 8; ++bit) c = c & 1 ? 0xEDB88320u ^ (c >> 1) : c >> 1;
      table_[n] = c;
    }
  }
  quint32 Of(const QByteArray& bytes) const {
    quint32 c = 0xFFFFFFFFu;
    for (const char b : bytes) c = table_[(c ^ quint32(uchar(b))) & 0xFF] ^ (c >> 8);
    return ~c;
  }

 private:
  std::array<quint32, 256> table_;
};

void AddNumber(QByteArray& out, quint32 value) {
  const quint32 big = qToBigEndian(value);
  out.append(reinterpret_cast<const char*>(&big), 4);
}

void AddChunk(QByteArray& out, const char* kind, const QByteArray& data) {
  static const Crc crc;
  AddNumber(out, quint32(data.size()));
  const QByteArray body = QByteArray(kind, 4) + data;
  out += body;
  AddNumber(out, crc.Of(body));
}

// The colours of a picture in the order of their first pixels, up to 256.
class Palette {
 public:
  // Nothing when the colour would be one too many.
  std::optional<uchar> IndexOf(QRgb colour) {
    size_t at = (colour * 2654435761u) >> 22;
    while (places_[at] >= 0) {
      if (colours_[size_t(places_[at])] == colour) return uchar(places_[at]);
      at = (at + 1) % places_.size();
    }
    if (colours_.size() == 256) return std::nullopt;
    places_[at] = qint16(colours_.size());
    colours_.push_back(colour);
    return uchar(places_[at]);
  }
  QByteArray Bytes() const {
    QByteArray out;
    for (const QRgb c : colours_) {
      const char rgb[] = {char(qRed(c)), char(qGreen(c)), char(qBlue(c))};
      out.append(rgb, 3);
    }
    return out;
  }
  Palette() { places_.fill(-1); }

 private:
  std::array<qint16, 1024> places_;
  std::vector<QRgb> colours_;
};

using Pictures = std::initializer_list<const QImage*>;

// Rows of one byte a pixel, each behind its filter's byte; nothing for too many colours.
std::optional<QByteArray> IndexedRows(Pictures pictures, int width, int height, Palette& palette) {
  QByteArray rows(qsizetype(width + 1) * height, Qt::Uninitialized);
  char* to = rows.data();
  QRgb last = 0;
  char index = 0;
  bool any = false;
  for (const QImage* picture : pictures) {
    for (int y = 0; y < picture->height(); ++y) {
      const auto* from = reinterpret_cast<const QRgb*>(picture->constScanLine(y));
      *to++ = 0;
      for (int x = 0; x < width; ++x) {
        const QRgb colour = from[x] | 0xFF000000;
        if (!any || colour != last) {
          const auto found = palette.IndexOf(colour);
          if (!found) return std::nullopt;
          index = char(*found);
          last = colour;
          any = true;
        }
        *to++ = index;
      }
    }
  }
  return rows;
}

QByteArray FullRows(Pictures pictures, int width, int height) {
  QByteArray rows((qsizetype(width) * 3 + 1) * height, Qt::Uninitialized);
  char* to = rows.data();
  for (const QImage* picture : pictures) {
    for (int y = 0; y < picture->height(); ++y) {
      const auto* from = reinterpret_cast<const QRgb*>(picture->constScanLine(y));
      *to++ = 0;
      for (int x = 0; x < width; ++x) {
        *to++ = char(qRed(from[x]));
        *to++ = char(qGreen(from[x]));
        *to++ = char(qBlue(from[x]));
      }
    }
  }
  return rows;
}

}  // namespace

QByteArray PngOf(Pictures pictures) {
  const QImage& first = **pictures.begin();
  const int width = first.width();
  int height = 0;
  for (const QImage* picture : pictures) height += picture->height();

  Palette palette;
  const auto indexed = IndexedRows(pictures, width, height, palette);
  const QByteArray data =
      qCompress(indexed ? *indexed : FullRows(pictures, width, height), kCompression);
  if (data.size() <= 4) throw RunTimeError(kOutOfMemory);

  QByteArray out("\x89PNG\r\n\x1a\n", 8);
  QByteArray header;
  AddNumber(header, quint32(width));
  AddNumber(header, quint32(height));
  const char kind[] = {8, char(indexed ? 3 : 2), 0, 0, 0};  // eight bits, by index or in full
  header.append(kind, sizeof kind);
  AddChunk(out, "IHDR", header);
  if (indexed) AddChunk(out, "PLTE", palette.Bytes());
  QByteArray dots;
  AddNumber(dots, quint32(first.dotsPerMeterX()));
  AddNumber(dots, quint32(first.dotsPerMeterY()));
  dots.append(char(1));  // to the metre
  AddChunk(out, "pHYs", dots);
  AddChunk(out, "IDAT", data.mid(4));  // behind the size that Qt puts in front
  AddChunk(out, "IEND", {});
  return out;
}

}  // namespace kora
