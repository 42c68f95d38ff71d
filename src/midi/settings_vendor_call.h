#pragma once

#include <cstdint>

namespace plugcore {

// effVendorSpecific with index kSettingsVendorIndex and one of these values
// loads (or saves) the instance's setting file whose path is at ptr; the
// plug-in answers 1 on success. Offline hosts use it to bring a control map
// along.
constexpr int32_t kSettingsVendorIndex = 0x56626D78;  // 'Vbmx'
constexpr intptr_t kSettingsLoadValue = 0x43666C64;   // 'Cfld'
constexpr intptr_t kSettingsSaveValue = 0x43667376;   // 'Cfsv'

}  // namespace plugcore
