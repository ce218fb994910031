#pragma once

#include <cstdint>
#include <functional>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "chart/chart_state.h"
#include "lists/chart_list.h"
#include "looks/colours.h"
#include "platform/settings_file.h"
#include "settings/settings.h"
#include "store/name_file.h"

// What chart selection decides. Its forms show the view and pass on what the user does.

namespace kora {

class Dialogs;

// The oscillators that chart selection offers, in the order of their table behind none; the
// place is the index of Combo2.
struct OscChoice {
  std::string_view caption, code;
};
std::span<const OscChoice> OscChoices();

inline constexpr std::string_view kFullListEntry = "Full List as per Name File";

// One entry of the list chooser: its text and item number, the ChartListNo it stands for.
struct ListEntry {
  std::string text;
  std::int16_t item = kFullList;
};
// The full list, the ten user lists and the scan results. A list whose file has fewer than 2
// bytes, or is not there, has " (Empty)" added.
std::vector<ListEntry> ListEntries(const Files& files, const std::string& dataPath,
                                   const SettingsFile& user);

// What the form shows. Colours are entries of ChartColours.
struct ChartSelectionView {
  std::string Label8;            // name of the list in use
  std::string Text1, Text2;      // code and name of the security on show
  std::string Text3 = "2";       // spacing
  std::string Text4, Text5;      // count of the list in use, ChartIndex
  std::string Text6 = "LATEST";  // finish date
  std::string Text7 = "ON";      // volumes
  std::string Text8;             // industry class
  std::string Label4 = "Chart Spacing";
  std::int16_t VScroll1 = 1, VScrollMax = 1;  // from 1
  int Combo1 = 0, Combo2 = 0, Combo3 = 0, Combo4 = 0;
  std::string OAve1, OAve2;  // captions: the periods
  bool OAve1Ticked = false, OAve2Ticked = false;
  int OAve1Colour = kBackground, OAve2Colour = kBackground;
  bool Check16 = false;
  bool IndustryEnabled = true;  // Check16 and Text8
  bool ExtrasEnabled = true;    // Combo2, Combo3, OAve1, OAve2: off for point and figure
  bool Command6Shown = false;
};

struct ChartSelectionServices {
  const Files& files;
  Dialogs& dialogs;
  Settings& settings;
  SettingsFile& ini;         // Kora.ini
  const SettingsFile& user;  // the per-user store: names of the lists
  ChartState& state;
  CurrentName& current;
};

// Indexes of Combo1 and Combo4.
enum StyleIndex { kBarIndex, kCandleIndex, kLineIndex, kPointFigureIndex };
enum PeriodIndex { kDailyIndex, kWeeklyIndex, kMonthlyIndex };

// Lives as long as the program; the forms come and go. Files are opened for each step that the
// user takes and closed at its end, so that what other forms saved meanwhile is seen. Every
// call that reads them tells a failure as "There is an unexpected error number ..." and leaves
// the security on show blank where it could not be read.
class ChartSelection {
 public:
  explicit ChartSelection(const ChartSelectionServices& services);

  const ChartSelectionView& view() const { return view_; }

  // ---- Opening and leaving

  void Load();
  // The same for the second chart of a pair, starting from the first: until the next Load no
  // choice touches the finish date, the oscillator or the style remembered for shares.
  void LoadSecond();
  // On return to the form. True when the list had changed: the code takes the focus.
  bool Activate();
  // Stores and writes the choices; ChartIndex is the place of the chart that was chosen.
  // False, with the message, when the spacing is no number that can be kept. For the second
  // chart only style, period and spacing are stored and nothing is written.
  bool OK();
  void Close();
  // After another data folder was chosen: the full list. Load follows.
  void FolderChanged();

  // ---- Which security

  enum class Entered {
    kNothing,  // an empty entry, or a refused search
    kFound,    // that code: the focus moves on to OK
    kNearest,  // another one: the focus stays
  };
  Entered EnterCode(std::string_view typed);
  // True when a search by name may open for the text; false with the message in a list.
  bool MaySearchByName(std::string_view text);
  // A search's match, a record of the name file, or none.
  void TakeSearch(std::optional<std::int16_t> record);
  void Scroll(std::int16_t value);
  // From the list chooser; nothing chosen stands for the first entry.
  void ChooseList(const ListEntry* chosen);

  // ---- How it is drawn

  void ChooseStyle(int index);
  void ChoosePeriod(int index);
  // True when the percentage bands are to be asked for.
  bool ChooseBands(int index);
  void ChooseOscillator(int index);
  void TickAverage(int which, bool ticked);  // 1 or 2
  // After the settings' averages were switched or saved elsewhere: on or off, and their periods.
  void AveragesChanged();
  void TypeSpacing(std::string_view text);  // as typed, no rule yet
  void LeaveSpacing();
  void StepSpacing(bool up);
  void FlipVolumes();
  // A click on the finish date. `ask` opens the date form and tells whether a date was chosen;
  // it stands in ChosenLimitText and ChosenLimitDate then.
  void ClickFinishDate(const std::function<bool()>& ask);
  void LatestDate();

  // ---- Industry filter

  // `typed`: from the picker, or typed in with ENTER.
  void EnterIndustry(std::string_view typed, bool fromPicker);
  void ClearIndustry() { DropFilter(); }
  // Before the picker opens.
  void StartIndustryPicker();

 private:
  struct Books;  // the open files

  template <typename Work>
  bool Guarded(Work work);
  Books checkNameFileOpen(std::string_view hint = {}, std::string_view title = "Chart Lists");
  void ShowFullList();
  void ShowListName();
  void ShowCount();
  void ShowRecord(const Books& books);
  void ShowName(const NameRec& rec, std::int32_t record);
  void GoTo(std::int16_t index);
  template <typename Match>
  bool FindFrom(const Books& books, std::int16_t from, Match match);
  void FindNextICRec(const Books& books);
  void TakeFound();
  bool TakeChoices();
  void Write(std::string_view key, const std::string& value);
  void WriteShared();
  void SetStyle(int index);
  void SetStyleForRecord(bool firstLoad);
  void ShowAverages();
  void ShowFinishDate();
  void DropFilter();
  void SpacingRange();
  void CandleSpacing();
  std::int16_t Count() const;
  bool FullList() const { return services_.state.ChartListNo == kFullList; }

  ChartSelectionServices services_;
  ChartSelectionView view_;
  Style rememberedStyle_ = Style::kBar;  // chosen for a share or index
  bool second_ = false;
};

}  // namespace kora
