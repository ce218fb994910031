#pragma once

#include <string_view>

#include "base/files.h"
#include "looks/colours.h"
#include "platform/surface.h"
#include "settings/settings.h"

namespace kora {

class Dialogs;

// Plays a chart script on `surface`, over what stands there. Letters in either case; X and K are
// for the printer and show nothing, any other letter and an empty line are passed over.
//
// True when the script was played to its end and held a command. False when it held none, or
// when a line could not be played: a seventh field, a number beyond its range, a font size that
// is none, a line longer than any script's, a last line cut off in the middle, or more drawing
// than any chart needs (a few seconds' worth). What was drawn until then stays. Never raises.
bool PlayChartScript(std::string_view script, Surface& surface, const FontSettings& fonts,
                     const ChartColours& colours);

// Shows a saved chart (a .cht file) in place of a composed one: clears the surface and plays the
// file. A file that can't be read or played gives the message about its format; a file larger
// than 16 MB is none of ours and is not read at all. True when the chart was played.
bool ShowSavedChart(const Files& files, Dialogs& dialogs, Surface& surface,
                    const FontSettings& fonts, const ChartColours& colours,
                    std::string_view SavedChartFile);

}  // namespace kora
