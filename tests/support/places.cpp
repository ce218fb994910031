#include "tests/support/places.h"

namespace kora {

std::string SourceDir() { return KORA_SOURCE_DIR; }
std::string BinDir() { return KORA_BIN_DIR; }
std::string DataDir() { return KORA_DATA_DIR; }

}  // namespace kora
