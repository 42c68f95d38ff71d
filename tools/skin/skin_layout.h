// Where everything sits on the 609 x 282 editor surface, and the geometry of each
// family of pictures relative to its control's position. The backgrounds, the
// preview sheets and the generated anchor header all read these tables.
#pragma once

#include <cstdint>

namespace skin {

constexpr int kEditorWidth = 609;
constexpr int kEditorHeight = 282;
constexpr int kKnobFrames = 97;
constexpr double kKnobFrame0Turns = 0.625;
// Turns covered by the whole strip: 0.75 * 98 / 97 of a turn, clockwise.
constexpr double kKnobTurnsCovered = -0.75773197;
constexpr double kFaderTravel = 437;
// Needle sweep in turns (value 0 .. 1), clockwise from straight up.
constexpr double kNeedleSpan = 0.3175;
constexpr double kNeedleOffset = -0.135;

struct BackgroundPlace {
  const char* name;
  int width, height;
  int left, top;  // where it is shown (a tip page where its band would be)
};

constexpr BackgroundPlace kBackgrounds[12] = {
    {"bkg_24_master", 147, 229, 0, 0},     {"bkg_24_top", 462, 36, 147, 0},
    {"bkg_24_band1", 115, 193, 147, 36},   {"bkg_24_band2", 114, 193, 262, 36},
    {"bkg_24_band3", 114, 193, 376, 36},   {"bkg_24_band4", 119, 193, 490, 36},
    {"bkg_24_tip1", 114, 193, 262, 36},    {"bkg_24_tip2pc", 114, 193, 376, 36},
    {"bkg_24_tip3", 119, 193, 490, 36},    {"bkg_24_edit", 117, 53, 0, 229},
    {"bkg_24_presets", 239, 53, 117, 229}, {"bkg_24_info", 253, 53, 356, 229},
};

// Picture geometry: the picture's top-left corner sits at control position + anchor;
// the pivot (picture coordinates, pixel edges at whole numbers) is the point that
// turns or centres on the control.
struct Family {
  const char* id;
  int width, height;
  int anchor_x, anchor_y;
  double pivot_x, pivot_y;
};

enum FamilyId {
  kKnobFrame, kKnobBack, kKnobActive, kFaderCap, kFaderTrack, kStereoSwitch, kWideSwitch, kWideSwitchFront,
  kSoloSwitch, kLamp, kClipLamp, kNeedle, kMeterFace, kMeterCover, kMarker, kProgramButton, kSetupButton, kSmallKnob,
  kSmallKnobPointer, kFamilyCount
};

constexpr Family kFamilies[kFamilyCount] = {
    {"KnobFrame", 31, 31, -15, -15, 15.5, 15.5},
    {"KnobBack", 39, 39, -19, -19, 19.5, 19.5},
    {"KnobActive", 39, 39, -19, -19, 19.5, 19.5},
    {"FaderCap", 9, 7, -4, -3, 4.5, 3.5},
    {"FaderTrack", 452, 7, -4, -3, 4.5, 3.5},
    {"StereoSwitch", 17, 17, 0, 0, 8.5, 8.5},
    {"WideSwitch", 57, 33, -16, -5, 28.5, 11.5},
    {"WideSwitchFront", 57, 33, -16, -5, 28.5, 11.5},
    {"SoloSwitch", 31, 18, -4, -3, 15.5, 9.0},
    {"Lamp", 17, 17, -8, -8, 8.5, 8.5},
    // The clip diode shows the same lamp with its top on the top of the diode's hit area.
    {"ClipLamp", 17, 17, -8, -5, 8.5, 8.5},
    {"Needle", 6, 59, -3, -59, 3.0, 59.0},
    {"MeterFace", 46, 37, -23, -59, 23.0, 59.0},
    {"MeterCover", 46, 37, -23, -59, 23.0, 59.0},
    {"Marker", 11, 11, -3, 0, 5.5, 5.5},
    {"ProgramButton", 13, 13, 0, 0, 6.5, 6.5},
    {"SetupButton", 57, 14, 0, 0, 28.5, 7.0},
    {"SmallKnob", 27, 27, -13, -14, 13.5, 13.5},
    {"SmallKnobPointer", 5, 5, -2, -2, 2.5, 2.5},
};

enum ControlKind { kCtlKnob, kCtlFader, kCtlStereo, kCtlWide, kCtlSolo, kCtlLamp, kCtlDiode, kCtlMeter,
                   kCtlProgram, kCtlPanelLamp, kCtlSmallKnob, kCtlDisplay, kCtlSetup };

struct Control {
  ControlKind kind;
  int x, y;           // editor position
  const char* label;  // printed on the background ("" when the picture carries it)
  int band;           // 0..3, or -1 for the master column and the panels
  double value;       // the parameter's default, normalised
  int scale_ticks;    // knob scale: number of marks
};

// Presets panel controls are placed in the panel's group, the setup button in the
// info panel's group; their positions below are already on the editor surface.
constexpr int kPresetsLeft = 117, kPresetsTop = 229;
constexpr int kInfoLeft = 356, kInfoTop = 229;

constexpr double kToneFreqDefault = 0.6609640474;
constexpr double kFeedbackFreqDefault = 0.6666666667;
constexpr double kMasterDefault = 0.8370612652;
constexpr double kBandVolumeDefault = 0.5187132600;

constexpr Control kMasterControls[] = {
    {kCtlWide, 26, 8, "OVERSAMPLING", -1, 0, 0},
    {kCtlKnob, 94, 22, "MASTER", -1, kMasterDefault, 11},
    {kCtlDiode, 126, 20, "CLIP", -1, 0, 0},
    {kCtlLamp, 68, 44, "", -1, 0, 0},
    {kCtlKnob, 35, 72, "FREQ", -1, kToneFreqDefault, 11},
    {kCtlKnob, 94, 72, "SHAPE", -1, 0, 11},
    {kCtlLamp, 92, 107, "", -1, 0, 0},
    {kCtlKnob, 35, 135, "FREQ", -1, kFeedbackFreqDefault, 11},
    {kCtlKnob, 94, 135, "AMOUNT", -1, 0, 11},
    {kCtlLamp, 120, 169, "", -1, 0, 0},
    {kCtlKnob, 35, 197, "PHASE", -1, 0, 11},
    {kCtlStereo, 112, 188, "BOOST", -1, 0, 0},
    {kCtlFader, 162, 10, "", -1, 1.0, 0},
    {kCtlFader, 162, 20, "", -1, 1.0, 0},
    {kCtlFader, 162, 30, "", -1, 1.0, 0},
};

constexpr int kBandKnobStep = 114;
constexpr int kSoloX[4] = {226, 340, 455, 569};

// One band's controls at band 1's positions; the others are kBandKnobStep apart
// (the solo switches use kSoloX).
constexpr Control kBandControls[] = {
    {kCtlSolo, 226, 39, "", 0, 0, 0},
    {kCtlKnob, 230, 82, "VOLUME", 0, kBandVolumeDefault, 11},
    {kCtlMeter, 180, 118, "", 0, 0, 0},
    {kCtlKnob, 177, 136, "CHARACTER", 0, 0.5, 11},
    {kCtlKnob, 230, 136, "INTENSITY", 0, 0, 11},
    {kCtlKnob, 177, 197, "DRIVE", 0, 1.0 / 3.0, 11},
    {kCtlKnob, 230, 197, "CURVE", 0, 0, 13},
};

constexpr Control kPanelControls[] = {
    {kCtlProgram, kPresetsLeft + 14, kPresetsTop + 16, "", -1, 0, 0},
    {kCtlPanelLamp, kPresetsLeft + 93, kPresetsTop + 22, "", -1, 0, 0},
    {kCtlDisplay, kPresetsLeft + 135, kPresetsTop + 28, "", -1, 0, 0},
    {kCtlSmallKnob, kPresetsLeft + 153, kPresetsTop + 31, "", -1, 0.1, 0},
    {kCtlPanelLamp, kPresetsLeft + 184, kPresetsTop + 22, "LOAD", -1, 0, 0},
    {kCtlPanelLamp, kPresetsLeft + 213, kPresetsTop + 22, "SAVE", -1, 0, 0},
    {kCtlSetup, kInfoLeft + 181, kInfoTop + 40, "", -1, 0, 0},
};

// Program button i sits at ((i mod 4) * 16 + 14, (i div 4 + 1) * 16) in the presets panel.
inline int program_button_x(int i) { return kPresetsLeft + (i % 4) * 16 + 14; }
inline int program_button_y(int i) { return kPresetsTop + (i / 4 + 1) * 16; }

// Accent colours: the master column and the four bands.
constexpr uint32_t kMasterAccent = 0xF0435A;
constexpr uint32_t kBandAccent[4] = {0xFF8C2E, 0xFFD23F, 0x3DDC97, 0x3FB6FF};
constexpr uint32_t kPanelAccent = 0x22D3EE;

// The knob frame index that shows a normalised value (the pot's own rule).
int knob_frame_for(double value);

}  // namespace skin
