#pragma once

namespace sys {

// The pots' mouse-compatibility mode as the user's per-user store keeps it:
// value "MouseCompatibility" under "Velmora", "0" off (the default) or "1" on.
constexpr const char* kMouseCompatibilityPath = "Velmora";
constexpr const char* kMouseCompatibilityName = "MouseCompatibility";

// 0 or 1; a missing or unrecognised value is stored as "0" and read as off.
int read_mouse_compatibility();
// true when the store took the value.
bool write_mouse_compatibility(int mode);

}  // namespace sys
