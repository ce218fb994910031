#pragma once

namespace kora {

// Screen readers are told a combo box by what its label calls it, and not by what is chosen in it,
// which is its value. To be called once, when the application stands.
void InstallAccessibleNames();

}  // namespace kora
