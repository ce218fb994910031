#pragma once

#include <array>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "chart/composer.h"
#include "indicators/oscillators.h"
#include "platform/settings_file.h"

// The multi-oscillator view: one price chart and under it the panels of up to four oscillators,
// from two sets that the user keeps in the per-user store.

namespace kora {

inline constexpr int kMultiOscSets = 2;  // counted from 1
inline constexpr size_t kMultiOscSlots = 4;
inline constexpr std::string_view kNoOscillator = "None";
inline constexpr std::string_view kNoMultiOsc = "No oscillators have been set";

// A name that a slot can hold.
struct MultiOscName {
  std::string_view name;
  const Oscillator* oscillator = nullptr;  // null: "None"
  bool slow = false;
};
// "None", then those that the table of oscillators offers the view, in its order.
std::span<const MultiOscName> MultiOscNames();
// The name as the list has it, in any case and without blanks around it; null for another text.
const MultiOscName* FindMultiOscName(std::string_view name);

// The names of the four slots.
using MultiOscSet = std::array<std::string, kMultiOscSlots>;
// Slots that aren't there, or are no name of the list, are "None".
MultiOscSet MultiOscSetOf(std::string_view text, char separator);
// Set 1 or 2, as kept under "Multi-Osc 1" or "Multi-Osc 2": the names with "|" between them.
MultiOscSet ReadMOSet(const SettingsFile& user, int set);
// False when the store can't be written.
bool SaveMOSets(SettingsFile& user, int set, const MultiOscSet& names);

// The slots that are not "None".
int PanelCount(const MultiOscSet& names);
// Height of each panel under a price picture of that height: they share as much once more.
double MultiOscPanelHeight(double priceHeight, int panelCount);
// What the view is called: the code and its set.
std::string MultiOscCaption(std::string_view code, int set);

// Composes the price chart and draws the set's oscillators, each on the surface of its place,
// which takes the scale of its share. In the script a panel follows the one before, with 3 units
// between them. An oscillator that fails is told, and the others are drawn. False when the price
// chart could not be drawn.
//
// `panels` has one surface for each slot that is not "None"; with no such slot nothing is drawn.
bool DrawMultiOsc(ChartServices services, const Settings& settings, const ChartRequest& request,
                  Composition& chart, const MultiOscSet& names, std::span<Surface* const> panels);

}  // namespace kora
