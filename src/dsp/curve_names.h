#pragma once

// Number of distortion curves a Dist Type parameter selects from.
constexpr int kNbrDistortionCurves = 13;

// Display name of curve `index` (0..12); an index outside gives "".
const char* distortion_curve_name(int index);
