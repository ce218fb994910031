#pragma once

#include <string>

namespace kora {

// Where the tests find what they read, as folders of the host without a slash at the end. They
// stand in one object file, so that the others compile to the same bytes in every checkout.
std::string SourceDir();  // the project
std::string BinDir();     // the programs just built
std::string DataDir();    // real prices, where there are some

}  // namespace kora
