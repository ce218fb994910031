#include "chartwindow/chart_selection.h"

#include <algorithm>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "indicators/oscillators.h"
#include "platform/dialogs.h"
#include "store/industry_classes.h"

namespace kora {
namespace {

constexpr std::string_view kTitle = "Chart Selection";
constexpr std::string_view kFullListLabel = " FULL LIST   (Names.Dat)";
constexpr std::string_view kLatest = "LATEST";

int IndexOf(Style style) {
  switch (style) {
    case Style::kBar: return kBarIndex;
    case Style::kCandlestick: return kCandleIndex;
    case Style::kPointFigure: return kPointFigureIndex;
    case Style::kLine: break;
  }
  return kLineIndex;
}

Style StyleOfIndex(int index) {
  switch (index) {
    case kBarIndex: return Style::kBar;
    case kCandleIndex: return Style::kCandlestick;
    case kPointFigureIndex: return Style::kPointFigure;
    default: return Style::kLine;
  }
}

int IndexOf(Period period) {
  switch (period) {
    case Period::kWeekly: return kWeeklyIndex;
    case Period::kMonthly: return kMonthlyIndex;
    case Period::kDaily: break;
  }
  return kDailyIndex;
}

Period PeriodOfIndex(int index) {
  return index == kWeeklyIndex    ? Period::kWeekly
         : index == kMonthlyIndex ? Period::kMonthly
                                  : Period::kDaily;
}

// The place of an oscillator's code in Combo2; 0 for one that it does not offer.
int IndexOfOsc(std::string_view code) {
  const std::span<const OscChoice> choices = OscChoices();
  const auto found = std::find_if(choices.begin(), choices.end(),
                                  [&](const OscChoice& o) { return o.code == code; });
  return found == choices.end() ? 0 : int(found - choices.begin());
}

std::string BoolText(bool value) { return value ? "True" : "False"; }

bool HasNoBars(const NameRec& rec) {
  return rec.RecType >= kCloseVolume && rec.RecType <= kAdvanceDecline;
}
bool HasBars(const NameRec& rec) { return rec.RecType == kShare || rec.RecType == kIndex; }

}  // namespace

std::span<const OscChoice> OscChoices() {
  static const std::vector<OscChoice> choices = [] {
    std::vector<OscChoice> all{{"(None)", ""}};
    for (const Oscillator& row : Oscillators())
      if (row.choice) all.push_back({row.choice, row.code});
    return all;
  }();
  return choices;
}

std::vector<ListEntry> ListEntries(const Files& files, const std::string& dataPath,
                                   const SettingsFile& user) {
  std::vector<ListEntry> out{{std::string(kFullListEntry), kFullList}};
  for (std::int16_t item = kFirstChartList; item <= kResultList; ++item) {
    std::string text = ChartListName(user, item);
    bool empty = true;
    try {
      const std::string path = ListFilePath(dataPath, item);
      empty = !files.CheckFile(path) || files.Open(path, OpenMode::kRead)->Size() < 2;
    } catch (const RunTimeError&) {
      // A list that can't be opened has nothing to show.
    }
    if (empty) text += " (Empty)";
    out.push_back({std::move(text), item});
  }
  return out;
}

struct ChartSelection::Books {
  NameFile names;
  std::vector<ListRec> list;  // of a chart list
};

ChartSelection::ChartSelection(const ChartSelectionServices& services) : services_(services) {}

template <typename Work>
bool ChartSelection::Guarded(Work work) {
  try {
    work();
    return true;
  } catch (const RunTimeError& e) {
    services_.dialogs.Message("There is an unexpected error number " + Str(e.number()),
                              "Chart Select");
    return false;
  }
}

// ---- Files

// The name file and the list in use, with their counts as they are now. A list that has lost
// all its records gives way to the full list.
ChartSelection::Books ChartSelection::checkNameFileOpen(std::string_view hint,
                                                        std::string_view title) {
  ChartState& state = services_.state;
  const std::string& dataPath = services_.settings.paths.CurrentDataPath;
  std::vector<ListRec> list;
  if (!FullList()) {
    list = ReadList(services_.files, dataPath, state.ChartListNo);
    state.ChartListCount = CInt(double(list.size()));
    if (list.empty()) {
      services_.dialogs.Message(
          " There are no records in " + view_.Label8 + " for this folder." + std::string(hint),
          title);
      state.ChartListNo = kFullList;
      ShowFullList();
    }
  }
  Books books{NameFile(services_.files, NameFilePath(dataPath)), std::move(list)};
  services_.current.NameCount = CInt(books.names.count());
  ShowCount();
  return books;
}

void ChartSelection::ShowFullList() {
  view_.Label8 = kFullListLabel;
  services_.state.ChartListName = kFullListLabel;
  view_.IndustryEnabled = true;
}

std::int16_t ChartSelection::Count() const {
  return FullList() ? services_.current.NameCount : services_.state.ChartListCount;
}

void ChartSelection::ShowCount() {
  view_.Text4 = Str(std::int32_t(Count()));
  view_.VScrollMax = std::max<std::int16_t>(Count(), 1);
}

void ChartSelection::GoTo(std::int16_t index) {
  services_.state.ChartIndex = index;
  view_.VScroll1 = index;
  view_.Text5 = Str(std::int32_t(index));
}

void ChartSelection::ShowName(const NameRec& rec, std::int32_t record) {
  CurrentName& current = services_.current;
  current.Rec = rec;
  current.NameRecNo = CInt(record);
  current.CurrentCode = std::string(rec.Code.trimmed());
  current.PriceFileName = current.CurrentCode + ".WDT";
  view_.Text1 = FromAnsi(rec.Code.trimmed());
  view_.Text2 = FromAnsi(rec.Name.trimmed());
}

// The record at ChartIndex. A list's record number is trusted, not its code; one outside the
// name file is error 63 and leaves no security on show.
void ChartSelection::ShowRecord(const Books& books) {
  ChartState& state = services_.state;
  GoTo(state.ChartIndex < 1 || state.ChartIndex > Count() ? std::int16_t(1) : state.ChartIndex);
  view_.Text1.clear();
  view_.Text2.clear();
  services_.current.PriceFileName.clear();
  const std::int16_t record =
      FullList() ? state.ChartIndex : books.list[size_t(state.ChartIndex - 1)].ListRecNo;
  ShowName(books.names.Read(record), record);
}

// Walks the list in use from a place on and shows the first record that matches. Places of a
// list whose record is not there are passed over.
template <typename Match>
bool ChartSelection::FindFrom(const Books& books, std::int16_t from, Match match) {
  const auto show = [&](const NameRec& rec, std::int32_t place, std::int32_t record) {
    GoTo(CInt(place));
    ShowName(rec, record);
    return true;
  };
  if (!FullList()) {
    const std::vector<NameRec> names = books.names.ReadAll();
    for (size_t i = size_t(from - 1); i < books.list.size(); ++i) {
      const std::int16_t record = books.list[i].ListRecNo;
      if (record < 1 || size_t(record) > names.size()) continue;
      const NameRec& rec = names[size_t(record - 1)];
      if (match(rec)) return show(rec, std::int32_t(i + 1), record);
    }
    return false;
  }
  constexpr std::int32_t kRun = 512;
  std::vector<NameRec> run;
  for (std::int32_t first = from; first <= books.names.count(); first += kRun) {
    run.resize(size_t(std::min(kRun, books.names.count() - first + 1)));
    books.names.ReadRun(first, run);
    for (size_t i = 0; i < run.size(); ++i)
      if (match(run[i])) return show(run[i], first + std::int32_t(i), first + std::int32_t(i));
  }
  return false;
}

// ---- Opening and leaving

void ChartSelection::Load() {
  ChartState& state = services_.state;
  const bool first = !state.ChartSelLoaded;
  second_ = false;
  view_ = {};
  view_.Command6Shown = services_.settings.download.DataService == 3;
  view_.Text7 = state.VolumeOption ? "ON" : "OFF";

  if (first) {
    const auto kept = [&](std::string_view key, std::string_view missing) {
      const std::string value = services_.ini.GetSetting("Charts", key);
      return value == kUnknown ? std::string(missing) : value;
    };
    state.ChartStyle = ParseStyle(kept("Type", "B")).value_or(Style::kLine);
    state.ChartPeriod = ParsePeriod(kept("Period", "A")).value_or(Period::kDaily);
    state.BandKind = SettingCInt(kept("Bands", "0"));
    state.Ma1On = services_.settings.charts.AvOne;
    state.Ma2On = services_.settings.charts.AvTwo;
    view_.Text3 = kept("Spacing", "2");
    // 0 stays: the composer takes it as 2.
    if (Val(view_.Text3) < 0 || Val(view_.Text3) > 10) view_.Text3 = "2";
    state.BarSpacing = CInt(Val(view_.Text3));
    state.ChartListNo = kFullList;
    rememberedStyle_ = state.ChartStyle;
  } else {
    view_.Text3 = Str(std::int32_t(state.BarSpacing));
    if (state.OscShown) {
      view_.Combo2 = IndexOfOsc(state.OscSelected);
      // Chosen, and not shown yet.
      if (view_.Combo2 == 0) view_.Combo2 = IndexOfOsc(state.OscCode);
    }
  }
  SetStyle(IndexOf(state.ChartStyle));
  view_.Combo4 = IndexOf(state.ChartPeriod);
  if (state.BandKind != 1 && state.BandKind != 2) state.BandKind = 0;
  view_.Combo3 = state.BandKind;
  view_.OAve1Ticked = state.Ma1On;
  view_.OAve2Ticked = state.Ma2On;
  view_.OAve1Colour = state.Ma1On ? kAverage2 : kBackground;
  view_.OAve2Colour = state.Ma2On ? kAverage3 : kBackground;
  ShowAverages();
  ShowFinishDate();

  if (state.ChartListNo < kFullList || state.ChartListNo >= kResultList)
    state.ChartListNo = kFullList;
  state.ChartSelLoaded = true;
  ShowListName();
  Guarded([&] {
    const Books books = checkNameFileOpen();
    ShowRecord(books);
    SetStyleForRecord(first);
  });
  if (FullList() && state.ICFilterOn) {
    if (state.ICFilter.empty()) {
      DropFilter();
    } else {
      view_.Check16 = true;
      view_.Text8 = state.ICFilter;
    }
  }
}

void ChartSelection::LoadSecond() {
  const ChartState& state = services_.state;
  second_ = true;
  view_ = {};
  view_.Text3 = Str(std::int32_t(state.BarSpacing));
  SetStyle(IndexOf(state.ChartStyle));
  view_.Combo4 = IndexOf(state.ChartPeriod);
  ShowAverages();
  ShowListName();
  Guarded([&] {
    ShowRecord(checkNameFileOpen());
    if (HasNoBars(services_.current.Rec)) SetStyle(kLineIndex);
  });
}

void ChartSelection::ShowListName() {
  ChartState& state = services_.state;
  if (FullList()) {
    ShowFullList();
    return;
  }
  view_.Label8 = state.ChartListName = ChartListName(services_.user, state.ChartListNo);
  view_.IndustryEnabled = false;
}

bool ChartSelection::Activate() {
  ChartState& state = services_.state;
  if (!state.ChartListChanged) return false;
  state.ChartListChanged = false;
  if (FullList()) {
    ShowFullList();
  } else {
    DropFilter();
    view_.IndustryEnabled = false;
    view_.Label8 = state.ChartListName;
  }
  Guarded([&] {
    const Books books = checkNameFileOpen(
        "\n At Main Menu click EDIT / Edit Chart Lists to create your special interest list",
        "Chart Lists  " + services_.settings.paths.CurrentDataPath);
    state.ChartIndex = 1;
    ShowRecord(books);
    SetStyleForRecord(false);
    view_.Combo4 = IndexOf(state.ChartPeriod);
    ShowAverages();
  });
  if (state.BarSpacing == 0) {
    state.BarSpacing = 2;
    view_.Text3 = "2";
  }
  return true;
}

void ChartSelection::ChooseList(const ListEntry* chosen) {
  ChartState& state = services_.state;
  const bool known = chosen && chosen->item >= kFullList && chosen->item <= kResultList;
  state.ChartListNo = known ? chosen->item : std::int16_t(kFullList);
  state.ChartListName = known ? chosen->text : std::string(kFullListEntry);
  state.ChartListChanged = true;
  state.ChartIndex = 0;
}

bool ChartSelection::TakeChoices() {
  ChartState& state = services_.state;
  return Guarded([&] {
    const double spacing = Val(view_.Text3);
    const Style style = StyleOfIndex(view_.Combo1);
    state.BarSpacing =
        style != Style::kPointFigure && spacing < 2 ? std::int16_t(2) : CInt(spacing);
    state.ChartStyle = style;
    state.ChartPeriod = PeriodOfIndex(view_.Combo4);
  });
}

bool ChartSelection::OK() {
  ChartState& state = services_.state;
  if (!TakeChoices()) return false;
  if (second_) return true;
  if (state.ChartStyle == Style::kPointFigure) {
    state.OscShown = false;
    state.BandKind = 0;
  } else {
    state.BandKind = std::int16_t(view_.Combo3);
    // The box says what is drawn, whatever the menu of the chart has drawn since.
    state.OscShown = view_.Combo2 != 0;
    if (state.OscShown)
      state.OscSelected = state.OscCode = std::string(OscChoices()[size_t(view_.Combo2)].code);
  }
  ChartSettings& charts = services_.settings.charts;
  const SettingsFile::Batch batch(services_.ini);
  Write("Type", charts.Type = TextOf(state.ChartStyle));
  Write("Period", charts.Period = TextOf(state.ChartPeriod));
  Write("Spacing", Str(std::int32_t(charts.Spacing = state.BarSpacing)));
  Write("Bands", Str(std::int32_t(charts.Bands = state.BandKind)));
  WriteShared();
  Write("List", Str(std::int32_t(charts.List = state.ChartListNo)));
  return true;
}

void ChartSelection::Close() {
  const ChartState& state = services_.state;
  ChartSettings& charts = services_.settings.charts;
  const SettingsFile::Batch batch(services_.ini);
  Write("Type", charts.Type = TextOf(state.ChartStyle));
  Write("Period", charts.Period = TextOf(state.ChartPeriod));
  if (state.BarSpacing >= 1 && state.BarSpacing <= 10)
    Write("Spacing", Str(std::int32_t(charts.Spacing = state.BarSpacing)));
  if (state.BandKind == 1 || state.BandKind == 2)
    Write("Bands", Str(std::int32_t(charts.Bands = state.BandKind)));
  if (state.ChartListNo >= 1 && state.ChartListNo <= 3)
    Write("List", Str(std::int32_t(charts.List = state.ChartListNo)));
  WriteShared();
}

void ChartSelection::WriteShared() {
  const ChartState& state = services_.state;
  ChartSettings& charts = services_.settings.charts;
  charts.AvOne = state.Ma1On;
  charts.AvTwo = state.Ma2On;
  Write("AutoOsc", charts.AutoOsc = BoolText(state.OscShown));
  Write("AvOne", BoolText(state.Ma1On));
  Write("AvTwo", BoolText(state.Ma2On));
}

// A value that can't be kept is one less for the next run; the work goes on.
void ChartSelection::Write(std::string_view key, const std::string& value) {
  services_.ini.PutSetting("Charts", key, value);
}

void ChartSelection::FolderChanged() {
  services_.state.ChartListNo = kFullList;
  services_.state.ChartListName.clear();
}

// ---- Which security

ChartSelection::Entered ChartSelection::EnterCode(std::string_view typed) {
  const std::string entry = UCase(Trim(typed));
  if (entry.empty()) return Entered::kNothing;
  const std::string code = PadRight(entry, 6);
  const std::string key = PadRight(entry.substr(0, 3), 3);
  Entered result = Entered::kNothing;
  Guarded([&] {
    const Books books = checkNameFileOpen();
    if (entry.size() <= 6 &&
        FindFrom(books, 1, [&](const NameRec& rec) { return rec.Code.raw() == code; })) {
      TakeFound();
      result = Entered::kFound;
      return;
    }
    if (services_.dialogs.Ask("No record on file for that code - Find nearest code ?", kTitle,
                              Buttons::kYesNo) != Answer::kYes)
      return;
    if (FindFrom(books, 1, [&](const NameRec& rec) { return rec.Code.raw().substr(0, 3) >= key; }))
      TakeFound();
    else
      Scroll(1);
    if (!second_) ChooseOscillator(0);
    result = Entered::kNearest;
  });
  return result;
}

void ChartSelection::TakeFound() {
  if (HasNoBars(services_.current.Rec))
    SetStyle(kLineIndex);
  else if (HasBars(services_.current.Rec))
    SetStyle(IndexOf(services_.state.ChartStyle));
  ChoosePeriod(kDailyIndex);
  SpacingRange();
}

bool ChartSelection::MaySearchByName(std::string_view text) {
  if (Trim(text).empty()) return false;
  if (FullList()) return true;
  constexpr std::string_view title = "Search by Name";
  services_.dialogs.Message("You have " + view_.Label8 + " selected.\n" +
                                "Search by NAME only available when using FULL LIST",
                            title);
  return false;
}

void ChartSelection::TakeSearch(std::optional<std::int16_t> record) {
  Guarded([&] {
    const Books books = checkNameFileOpen();
    services_.state.ChartIndex = record.value_or(1);
    ShowRecord(books);
    if (HasNoBars(services_.current.Rec)) SetStyle(kLineIndex);
  });
}

void ChartSelection::Scroll(std::int16_t value) {
  Guarded([&] {
    const Books books = checkNameFileOpen();
    GoTo(value < 1 || value > Count() ? std::int16_t(1) : value);
    if (services_.state.ICFilterOn && FullList()) {
      FindNextICRec(books);
      return;
    }
    ShowRecord(books);
    if (HasNoBars(services_.current.Rec)) SetStyle(kLineIndex);
  });
}

// ---- Industry filter

void ChartSelection::FindNextICRec(const Books& books) {
  ChartState& state = services_.state;
  if (state.ICFilter.empty()) {
    ShowRecord(books);
    return;
  }
  const auto matches = [&](const NameRec& rec) {
    return MatchesIndClass(rec.IndClass.trimmed(), state.ICFilter);
  };
  if (!FindFrom(books, state.ChartIndex, matches)) {
    services_.dialogs.Message("No records on file for that Industry classification or group",
                              "Industry Classification");
    DropFilter();
    GoTo(1);
    ShowRecord(books);
    return;
  }
  if (HasNoBars(services_.current.Rec))
    SetStyle(kLineIndex);
  else if (HasBars(services_.current.Rec))
    SetStyle(kBarIndex);
  ChoosePeriod(kDailyIndex);
  SpacingRange();
}

void ChartSelection::StartIndustryPicker() {
  view_.Check16 = true;
  services_.state.ICFilterOn = true;
}

void ChartSelection::EnterIndustry(std::string_view typed, bool fromPicker) {
  const std::string filter(Trim(typed));
  if (filter.empty()) {
    if (fromPicker) services_.dialogs.Message("Industry Classification invalid", "Analysis");
    DropFilter();
    return;
  }
  StartIndustryPicker();
  services_.state.ICFilter = view_.Text8 = filter;
  Guarded([&] {
    const Books books = checkNameFileOpen();
    GoTo(1);
    FindNextICRec(books);
  });
}

void ChartSelection::DropFilter() {
  services_.state.ICFilterOn = false;
  services_.state.ICFilter.clear();
  view_.Check16 = false;
  view_.Text8.clear();
}

// ---- How it is drawn

// What goes with a style wherever it comes from.
void ChartSelection::SetStyle(int index) {
  ChartState& state = services_.state;
  view_.Combo1 = index;
  view_.ExtrasEnabled = index != kPointFigureIndex;
  view_.Label4 = index == kPointFigureIndex ? "Point Reversal" : "Chart Spacing";
  if (index != kPointFigureIndex) return;
  view_.Combo4 = kDailyIndex;
  if (second_) return;
  view_.Combo2 = 0;
  state.OscShown = false;
  LatestDate();
}

void ChartSelection::SetStyleForRecord(bool firstLoad) {
  if (HasNoBars(services_.current.Rec))
    SetStyle(firstLoad && services_.state.ChartStyle == Style::kPointFigure ? kPointFigureIndex
                                                                            : kLineIndex);
  else if (HasBars(services_.current.Rec))
    SetStyle(IndexOf(rememberedStyle_));
}

void ChartSelection::ChooseStyle(int index) {
  if (index < kBarIndex || index > kPointFigureIndex) return;
  SetStyle(index);
  if (!second_ && HasBars(services_.current.Rec)) rememberedStyle_ = StyleOfIndex(index);
  CandleSpacing();
}

void ChartSelection::ChoosePeriod(int index) {
  if (index < kDailyIndex || index > kMonthlyIndex) return;
  view_.Combo4 = index;
  if (view_.Combo1 != kPointFigureIndex) ShowAverages();
}

void ChartSelection::ShowAverages() {
  const ChartSettings& charts = services_.settings.charts;
  const bool daily = view_.Combo4 == kDailyIndex;
  view_.OAve1 = Str(std::int32_t(daily ? charts.Av1D : charts.Av1W));
  view_.OAve2 = Str(std::int32_t(daily ? charts.Av2D : charts.Av2W));
}

void ChartSelection::TickAverage(int which, bool ticked) {
  constexpr int kBlack = 0;
  if (which == 1) {
    services_.state.Ma1On = view_.OAve1Ticked = ticked;
    view_.OAve1Colour = ticked ? int(kAverage2) : kBlack;
  } else {
    services_.state.Ma2On = view_.OAve2Ticked = ticked;
    view_.OAve2Colour = ticked ? int(kAverage3) : kBlack;
  }
}

void ChartSelection::AveragesChanged() {
  const ChartSettings& charts = services_.settings.charts;
  TickAverage(1, charts.AvOne);
  TickAverage(2, charts.AvTwo);
  ShowAverages();
}

bool ChartSelection::ChooseBands(int index) {
  if (index < 0 || index > 2) return false;
  view_.Combo3 = index;
  services_.state.BandKind = std::int16_t(index);
  return index == 1;
}

void ChartSelection::ChooseOscillator(int index) {
  if (index < 0 || size_t(index) >= OscChoices().size()) return;
  view_.Combo2 = index;
  services_.state.OscShown = index != 0;
  if (index != 0) services_.state.OscCode = std::string(OscChoices()[size_t(index)].code);
}

void ChartSelection::TypeSpacing(std::string_view text) { view_.Text3 = std::string(text); }

void ChartSelection::LeaveSpacing() {
  const double value = Val(view_.Text3);
  if (value < 1)
    view_.Text3 = "2";
  else if (value > 20)
    view_.Text3 = "20";
  CandleSpacing();
}

void ChartSelection::StepSpacing(bool up) {
  double value = Trim(view_.Text3).empty() ? 1 : Val(view_.Text3);
  value += up ? 1 : -1;
  if (up && value > 10) value = 1;
  if (!up && value <= 0) value = 10;
  view_.Text3 = Str(value);
  CandleSpacing();
}

// A candle needs three units.
void ChartSelection::CandleSpacing() {
  if (view_.Combo1 == kCandleIndex && Val(view_.Text3) < 3) view_.Text3 = "3";
}

// What a newly found security leaves of the spacing.
void ChartSelection::SpacingRange() {
  const double value = Val(view_.Text3);
  if (value < 1 || value > 20) view_.Text3 = "2";
}

void ChartSelection::FlipVolumes() {
  ChartState& state = services_.state;
  state.VolumeOption = !state.VolumeOption;
  view_.Text7 = state.VolumeOption ? "ON" : "OFF";
}

void ChartSelection::ClickFinishDate(const std::function<bool()>& ask) {
  ChartState& state = services_.state;
  if (view_.Combo1 == kPointFigureIndex || view_.Text6 != kLatest) {
    LatestDate();
    return;
  }
  if (!ask) return;
  state.DateLimitOn = true;
  if (!ask()) {
    LatestDate();
    return;
  }
  state.DateLimitText = state.ChosenLimitText;
  state.DateLimitDate = state.ChosenLimitDate;
  ShowFinishDate();
}

void ChartSelection::LatestDate() {
  services_.state.DateLimitOn = false;
  services_.state.ScrollInUse = false;
  view_.Text6 = kLatest;
}

void ChartSelection::ShowFinishDate() {
  const ChartState& state = services_.state;
  view_.Text6 = state.DateLimitOn ? state.ChosenLimitText : std::string(kLatest);
}

}  // namespace kora
