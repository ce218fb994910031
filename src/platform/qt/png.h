#pragma once

#include <QByteArray>
#include <QImage>
#include <initializer_list>

namespace kora {

// A PNG of pictures of 32-bit pixels (Format_RGB32) and one width, one below the other, at the
// dots to the metre of the first. It keeps every pixel as it is. A chart's flat colours need
// neither the filters nor the search of a general writer, which take several times what drawing
// does. Error 7 where memory gives out.
QByteArray PngOf(std::initializer_list<const QImage*> pictures);

}  // namespace kora
