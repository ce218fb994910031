#pragma once

#include <span>
#include <string>
#include <string_view>

#include "settings/settings.h"

namespace kora {

// One entry of the main menu. A menu and a submenu are entries too; `parent` is the menu that
// an entry stands in, empty for those of the menu bar.
struct MenuEntry {
  std::string_view name;
  std::string_view caption;  // "&" before the mnemonic
  std::string_view parent;
};

// In the order in which they stand.
std::span<const MenuEntry> MainMenu();

struct EntryState {
  bool enabled = true;
  bool visible = true;
};

// How the settings leave an entry while no long task runs: the download entries follow the
// service in use, moving data between folders needs the service with several folders.
EntryState MenuEntryState(std::string_view name, const DownloadSettings& download,
                          const CommandWords& words);

// True for the menus that a long task disables together.
bool DisabledByLongTask(std::string_view menu);

// "KORA Charting 7F   -   Current Data Folder c:\korawin\data\"
std::string MainTitle(const Paths& paths);

// The main window's size in twips (1/1440 inch, 15 to a pixel of 96 to the inch).
struct MainSize {
  int height = 6645;
  int width = 9045;
  bool heightKept = false, widthKept = false;  // from the store, not the default
};
// From the per-user values Height and Width: what is below 3000, or no number, is the default.
MainSize MainWindowSize(std::string_view height, std::string_view width);

// Where a form of this size stands in the middle of the screen, a little above the centre.
struct FormPlace {
  int left, top;
};
FormPlace CentreForm(double screenWidth, double screenHeight, double width, double height);

}  // namespace kora
