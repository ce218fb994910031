#include "settings/settings.h"

namespace kora {

const std::array<OscKey, 22>& OscKeys() {
  using O = OscSettings;
  static const std::array<OscKey, 22> keys{{
      {"StochK", "StochKW", 10, 10, &O::StochK}, {"StochD", "StochDW", 5, 5, &O::StochD},
      {"FXF", "FXFW", 50, 50, &O::FXF},          {"FXX", "FXXW", 25, 25, &O::FXX},
      {"RocP", "RocPW", 21, 21, &O::RocP},       {"RocA", "RocAW", 10, 10, &O::RocA},
      {"RsiP", "RsiPW", 14, 14, &O::RsiP},       {"RmoP", "RmoPW", 30, 30, &O::RmoP},
      {"RmoA", "RmoAW", 10, 10, &O::RmoA},       {"RmxP", "RmxPW", 100, 50, &O::RmxP},
      {"RmxA", "RmxAW", 20, 20, &O::RmxA},       {"Md1", "Md1W", 12, 12, &O::Md1},
      {"Md2", "Md2W", 26, 26, &O::Md2},          {"Md3", "Md3W", 9, 9, &O::Md3},
      {"WmsA", "WmsW", 7, 7, &O::WmsA},          {"ERA", "ERW", 14, 14, &O::ERA},
      {"DMA", "DMW", 14, 14, &O::DMA},           {"DMXA", "DMXW", 14, 14, &O::DMXA},
      {"MMA", "MMW", 14, 14, &O::MMA},           {"CopD", "CopW", 14, 14, &O::CopD},
      {"HolyD", "HolyW", 50, 50, &O::HolyD},     {"VtyD", "VtyW", 3, 3, &O::VtyD},
  }};
  return keys;
}

}  // namespace kora
