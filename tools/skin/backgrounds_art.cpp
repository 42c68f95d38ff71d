// The twelve backgrounds: the master column, the split strip, four band pages,
// three tip pages and the three bottom panels, with every caption, scale and title.
#include <algorithm>
#include <cmath>
#include <sstream>
#include <string>
#include <vector>

#include "pictures.h"

namespace skin {

namespace {

constexpr double kPi = 3.14159265358979323846;
const Rgb kLabel = hex(0xC7CCD4);
const Rgb kDimLabel = hex(0x7E8590);

void panel(Canvas& c, uint32_t top, uint32_t bottom, uint32_t seed) {
  cairo_t* cr = c.cr();
  cairo_pattern_t* pat = cairo_pattern_create_linear(0, 0, 0, c.height());
  const Rgb a = hex(top), b = hex(bottom);
  cairo_pattern_add_color_stop_rgb(pat, 0, a.r, a.g, a.b);
  cairo_pattern_add_color_stop_rgb(pat, 1, b.r, b.g, b.b);
  cairo_set_source(cr, pat);
  cairo_paint(cr);
  cairo_pattern_destroy(pat);
  brush_grain(c, seed, 0.035);
}

void bevel(Canvas& c) {
  cairo_t* cr = c.cr();
  const double w = c.width(), h = c.height();
  cairo_set_line_width(cr, 1);
  cairo_set_source_rgba(cr, 1, 1, 1, 0.11);
  cairo_move_to(cr, 0, 0.5);
  cairo_line_to(cr, w, 0.5);
  cairo_stroke(cr);
  cairo_set_source_rgba(cr, 1, 1, 1, 0.06);
  cairo_move_to(cr, 0.5, 0);
  cairo_line_to(cr, 0.5, h);
  cairo_stroke(cr);
  cairo_set_source_rgba(cr, 0, 0, 0, 0.55);
  cairo_move_to(cr, 0, h - 0.5);
  cairo_line_to(cr, w, h - 0.5);
  cairo_stroke(cr);
  cairo_set_source_rgba(cr, 0, 0, 0, 0.45);
  cairo_move_to(cr, w - 0.5, 0);
  cairo_line_to(cr, w - 0.5, h);
  cairo_stroke(cr);
}

void label(cairo_t* cr, const std::string& text, double cx, double baseline, const Rgb& colour, double max_width = 56,
           double size = 9) {
  const double tracking = text.size() > 6 ? 0.0 : 0.5;
  fit_font(cr, Face::kCondensedBold, text, size, 7.5, max_width, tracking);
  // An engraved look: a dark shadow one pixel below.
  cairo_set_source_rgba(cr, 0, 0, 0, 0.55);
  draw_text(cr, text, cx, baseline + 1, Align::kCentre, tracking);
  set_rgb(cr, colour);
  draw_text(cr, text, cx, baseline, Align::kCentre, tracking);
}

// Marks around a knob, on a 270-degree sweep from lower left to lower right.
void knob_scale(cairo_t* cr, double cx, double cy, int ticks, const Rgb& accent) {
  const double start = 0.625 * 2 * kPi, span = -0.75 * 2 * kPi;
  cairo_set_line_cap(cr, CAIRO_LINE_CAP_BUTT);
  cairo_set_line_width(cr, 1.3);
  set_rgb(cr, accent, 0.55);
  cairo_arc(cr, cx, cy, 16.8, -start, -(start + span));
  cairo_stroke(cr);
  for (int i = 0; i < ticks; ++i) {
    const double a = start + span * i / (ticks - 1);
    const bool major = i == 0 || i == ticks - 1 || (ticks == 11 && i == 5);
    const double r0 = 17.2, r1 = major ? 20.2 : 19.2;
    cairo_set_line_width(cr, major ? 1.2 : 0.9);
    set_rgb(cr, major ? mix(accent, hex(0xFFFFFF), 0.35) : hex(0xA9B0BA), major ? 1.0 : 0.75);
    cairo_move_to(cr, cx + r0 * std::cos(a), cy - r0 * std::sin(a));
    cairo_line_to(cr, cx + r1 * std::cos(a), cy - r1 * std::sin(a));
    cairo_stroke(cr);
  }
}

// A section title with a rule running to `rule_end`.
void section(cairo_t* cr, const std::string& text, double x, double baseline, double rule_end, const Rgb& accent) {
  use_font(cr, Face::kCondensedBold, 9);
  set_rgb(cr, accent);
  draw_text(cr, text, x, baseline, Align::kLeft, 1.0);
  const double end = x + text_width(cr, text, 1.0) + 4;
  if (rule_end > end) {
    cairo_set_line_width(cr, 1);
    set_rgb(cr, accent, 0.45);
    cairo_move_to(cr, std::floor(end), std::floor(baseline - 3) + 0.5);
    cairo_line_to(cr, rule_end, std::floor(baseline - 3) + 0.5);
    cairo_stroke(cr);
  }
}

void recess(cairo_t* cr, double x, double y, double w, double h, double r) {
  rounded_rect(cr, x - 1, y - 1, w + 2, h + 2, r + 1);
  cairo_set_source_rgba(cr, 0, 0, 0, 0.55);
  cairo_fill(cr);
  cairo_set_line_width(cr, 1);
  cairo_set_source_rgba(cr, 1, 1, 1, 0.09);
  cairo_move_to(cr, x, y + h + 1.5);
  cairo_line_to(cr, x + w, y + h + 1.5);
  cairo_stroke(cr);
}

Picture finish(const std::string& name, const Canvas& c) {
  Picture p;
  p.name = name;
  p.kind = kApicOpaque;
  p.flag = kFlagDefault;
  p.image = c.to_rgba();
  return p;
}

const Family& fam(FamilyId id) { return kFamilies[id]; }

// Knob centre on a background whose top-left corner is at (left, top).
double centre_x(int x, int left) { return x - left + fam(kKnobFrame).anchor_x + fam(kKnobFrame).pivot_x; }
double centre_y(int y, int top) { return y - top + fam(kKnobFrame).anchor_y + fam(kKnobFrame).pivot_y; }

Picture master() {
  const BackgroundPlace& bp = kBackgrounds[0];
  Canvas c(bp.width, bp.height);
  panel(c, 0x30353D, 0x22262C, 11);
  cairo_t* cr = c.cr();
  const Rgb accent = hex(kMasterAccent);
  for (const Control& k : kMasterControls) {
    if (k.kind == kCtlKnob) {
      const double cx = centre_x(k.x, 0), cy = centre_y(k.y, 0);
      knob_scale(cr, cx, cy, k.scale_ticks, accent);
      // The master label shares its row with the tone lamp, so it stays narrow.
      label(cr, k.label, cx, cy + 27.5, kLabel, k.y == 22 ? 33 : 52);
    }
  }
  const Family& wide = fam(kWideSwitch);
  label(cr, "OVERSAMPLING", 26 + wide.anchor_x + wide.pivot_x, 35, kLabel, 56, 8.5);
  label(cr, "CLIP", 126.5, 41, kLabel);
  label(cr, "BOOST", 112 + fam(kStereoSwitch).pivot_x, 215, kLabel);
  section(cr, "TONE", 9, 49, 58, accent);
  section(cr, "FEEDBACK", 9, 111, 82, accent);
  section(cr, "STEREO", 9, 173, 110, accent);
  bevel(c);
  return finish(bp.name, c);
}

Picture top_strip() {
  const BackgroundPlace& bp = kBackgrounds[1];
  Canvas c(bp.width, bp.height);
  panel(c, 0x1E2126, 0x191B1F, 12);
  cairo_t* cr = c.cr();
  for (int k = 0; k < 3; ++k) {
    // Each split hands over from band k+1 to band k+2: a pip in each colour.
    const double y = 10 + 10 * k - 3;
    rounded_rect(cr, 3, y + 1, 3, 5, 1);
    set_rgb(cr, hex(kBandAccent[k]));
    cairo_fill(cr);
    rounded_rect(cr, 7, y + 1, 3, 5, 1);
    set_rgb(cr, hex(kBandAccent[k + 1]));
    cairo_fill(cr);
  }
  bevel(c);
  return finish(bp.name, c);
}

Picture band_page(int b) {
  const BackgroundPlace& bp = kBackgrounds[2 + b];
  Canvas c(bp.width, bp.height);
  panel(c, 0x2D3239, 0x23272D, 20 + b);
  cairo_t* cr = c.cr();
  const Rgb accent = hex(kBandAccent[b]);
  set_rgb(cr, accent, 0.9);
  cairo_rectangle(cr, 0, 0, bp.width, 2);
  cairo_fill(cr);
  use_font(cr, Face::kCondensedBold, 10);
  set_rgb(cr, accent);
  draw_text(cr, "BAND " + std::to_string(b + 1), 7, 14, Align::kLeft, 1.2);
  // One size for all knob labels of a band: the size at which the longest fits.
  double size = 9;
  for (const Control& k : kBandControls) {
    if (k.kind == kCtlKnob) {
      const double tracking = std::string(k.label).size() > 6 ? 0.0 : 0.5;
      size = std::min(size, fit_font(cr, Face::kCondensedBold, k.label, 9, 7.5, 46, tracking));
    }
  }
  for (const Control& k : kBandControls) {
    const int x = k.kind == kCtlSolo ? kSoloX[b] : k.x + kBandKnobStep * b;
    if (k.kind == kCtlKnob) {
      const double cx = centre_x(x, bp.left), cy = centre_y(k.y, bp.top);
      knob_scale(cr, cx, cy, k.scale_ticks, accent);
      label(cr, k.label, cx, cy + 27.5, kLabel, 46, size);
    } else if (k.kind == kCtlMeter) {
      const Family& f = fam(kMeterFace);
      recess(cr, x - bp.left + f.anchor_x, k.y - bp.top + f.anchor_y, f.width, f.height, 3);
    }
  }
  bevel(c);
  return finish(bp.name, c);
}

std::vector<std::string> wrap(cairo_t* cr, const std::string& text, double width) {
  std::istringstream words(text);
  std::vector<std::string> lines;
  std::string word, line;
  while (words >> word) {
    const std::string attempt = line.empty() ? word : line + " " + word;
    if (!line.empty() && text_width(cr, attempt) > width) {
      lines.push_back(line);
      line = word;
    } else {
      line = attempt;
    }
  }
  if (!line.empty()) {
    lines.push_back(line);
  }
  return lines;
}

Picture tip_page(int b) {
  static const char* const kTexts[3] = {
      "Band 2 is off. Drag the top split slider left from its right end: band 2 then takes "
      "everything above that frequency.",
      "Band 3 is off. Drag the middle split slider left from its right end; the top slider "
      "follows when it has to.",
      "Band 4 is off. Drag the bottom split slider left from its right end, and band 4 takes "
      "the highs above it.",
  };
  const BackgroundPlace& bp = kBackgrounds[6 + (b - 1)];
  Canvas c(bp.width, bp.height);
  panel(c, 0x23272D, 0x1B1E22, 30 + b);
  cairo_t* cr = c.cr();
  const Rgb accent = hex(kBandAccent[b]);
  set_rgb(cr, accent, 0.35);
  cairo_rectangle(cr, 0, 0, bp.width, 2);
  cairo_fill(cr);
  use_font(cr, Face::kCondensedBold, 10);
  set_rgb(cr, scale(accent, 0.75));
  draw_text(cr, "BAND " + std::to_string(b + 1), 7, 14, Align::kLeft, 1.2);
  use_font(cr, Face::kCondensedBold, 8);
  rounded_rect(cr, bp.width - 31, 5, 24, 11, 3);
  set_rgb(cr, hex(0x121417));
  cairo_fill(cr);
  set_rgb(cr, kDimLabel);
  draw_text(cr, "OFF", bp.width - 19, 13.5, Align::kCentre, 0.8);
  // A small picture of the three split sliders, the one to move lit in the band colour.
  const double left = 12, right = bp.width - 12;
  for (int k = 0; k < 3; ++k) {
    const double y = 32.5 + 10 * k;
    const bool active = k == b - 1;
    cairo_set_line_width(cr, 3);
    set_rgb(cr, hex(0x0A0B0D));
    cairo_move_to(cr, left, y);
    cairo_line_to(cr, right, y);
    cairo_stroke(cr);
    const double cap = active ? right - 30 : (k < b - 1 ? left + 12 + 14 * k : right);
    rounded_rect(cr, cap - 3.5, y - 3.5, 7, 7, 1.5);
    set_rgb(cr, active ? accent : hex(0x6E757F));
    cairo_fill(cr);
    if (active) {
      cairo_set_line_width(cr, 1.2);
      set_rgb(cr, accent, 0.8);
      cairo_move_to(cr, right, y);
      cairo_line_to(cr, cap + 6, y);
      cairo_stroke(cr);
      cairo_move_to(cr, cap + 5, y);
      cairo_line_to(cr, cap + 9, y - 3);
      cairo_line_to(cr, cap + 9, y + 3);
      cairo_close_path(cr);
      cairo_fill(cr);
    }
  }
  use_font(cr, Face::kCondensed, 10);
  const std::vector<std::string> lines = wrap(cr, kTexts[b - 1], bp.width - 16);
  double y = 80;
  for (const std::string& line : lines) {
    set_rgb(cr, hex(0xB4BAC3));
    draw_text(cr, line, 8, y, Align::kLeft);
    y += 12;
  }
  bevel(c);
  return finish(bp.name, c);
}

Picture edit_panel() {
  const BackgroundPlace& bp = kBackgrounds[9];
  Canvas c(bp.width, bp.height);
  panel(c, 0x2A2E35, 0x1F2227, 40);
  cairo_t* cr = c.cr();
  const double size = fit_font(cr, Face::kBold, "Brakmorph", 18, 12, 100, 0.2);
  use_font(cr, Face::kBold, size);
  const double w = text_width(cr, "Brakmorph", 0.2);
  const double x = (bp.width - w) / 2;
  cairo_set_source_rgba(cr, 0, 0, 0, 0.6);
  draw_text(cr, "Brakmorph", x, 26, Align::kLeft, 0.2);
  set_rgb(cr, hex(0xECEFF3));
  draw_text(cr, "Brakmorph", x, 25, Align::kLeft, 0.2);
  // The four band colours as one bar: the product's signature.
  for (int b = 0; b < 4; ++b) {
    set_rgb(cr, hex(kBandAccent[b]));
    cairo_rectangle(cr, std::floor(x) + b * std::floor(w / 4), 29, std::floor(w / 4) - 1, 2);
    cairo_fill(cr);
  }
  fit_font(cr, Face::kCondensedBold, "MULTIBAND DISTORTION", 8, 7, bp.width - 12, 0.6);
  set_rgb(cr, kDimLabel);
  draw_text(cr, "MULTIBAND DISTORTION", bp.width / 2.0, 43, Align::kCentre, 0.6);
  bevel(c);
  return finish(bp.name, c);
}

Picture presets_panel() {
  const BackgroundPlace& bp = kBackgrounds[10];
  Canvas c(bp.width, bp.height);
  panel(c, 0x2A2E35, 0x1F2227, 41);
  cairo_t* cr = c.cr();
  const Rgb accent = hex(kPanelAccent);
  // Captions share the size at which the longest fits its column.
  const double caption_size = std::min(fit_font(cr, Face::kCondensedBold, "PROGRAMS", 8.5, 7, 42, 0.3),
                                       fit_font(cr, Face::kCondensedBold, "FADE TIME", 8.5, 7, 42, 0.3));
  auto caption = [&](const std::string& text, double cx, double baseline) {
    use_font(cr, Face::kCondensedBold, caption_size);
    set_rgb(cr, accent, 0.9);
    draw_text(cr, text, cx, baseline, Align::kCentre, 0.3);
  };
  caption("PROGRAMS", 14 + 30.5, 11);
  // The mode switch: dark means load, lit means store.
  caption("LOAD", 93.5, 11);
  caption("FADE TIME", 139, 11);
  caption("BANK", 198.5, 11);
  // Recesses behind the program buttons.
  for (int i = 0; i < 8; ++i) {
    const int x = program_button_x(i) - kPresetsLeft, y = program_button_y(i) - kPresetsTop;
    rounded_rect(cr, x - 1, y - 1, 15, 15, 3);
    cairo_set_source_rgba(cr, 0, 0, 0, 0.5);
    cairo_fill(cr);
  }
  label(cr, "STORE", 93.5, 43, kLabel, 28, 8);
  label(cr, "LOAD", 184.5, 43, kLabel, 26, 8);
  label(cr, "SAVE", 213.5, 43, kLabel, 26, 8);
  // The fade-time display: a dark window for the cyan digits.
  rounded_rect(cr, 110.5, 27.5, 26, 17, 2);
  cairo_set_source_rgba(cr, 0, 0, 0, 0.6);
  cairo_fill(cr);
  cairo_pattern_t* lcd = cairo_pattern_create_linear(0, 28, 0, 44);
  cairo_pattern_add_color_stop_rgb(lcd, 0, 0.02, 0.07, 0.08);
  cairo_pattern_add_color_stop_rgb(lcd, 1, 0.03, 0.11, 0.12);
  cairo_set_source(cr, lcd);
  cairo_rectangle(cr, 111, 28, 24, 15);
  cairo_fill(cr);
  cairo_pattern_destroy(lcd);
  use_font(cr, Face::kCondensedBold, 7.5);
  set_rgb(cr, kDimLabel);
  draw_text(cr, "SEC", 123, 51.5, Align::kCentre, 0.8);
  // Dots around the fade-time knob.
  const Family& sk = fam(kSmallKnob);
  const double cx = 153 + sk.anchor_x + sk.pivot_x, cy = 31 + sk.anchor_y + sk.pivot_y;
  for (int i = 0; i < 7; ++i) {
    const double a = 2 * kPi * (0.625 - 0.75 * i / 6.0);
    set_rgb(cr, i == 0 || i == 6 ? accent : hex(0x9AA1AB), 0.9);
    cairo_arc(cr, cx + 13.6 * std::cos(a), cy - 13.6 * std::sin(a), 0.75, 0, 2 * kPi);
    cairo_fill(cr);
  }
  bevel(c);
  return finish(bp.name, c);
}

Picture info_panel() {
  const BackgroundPlace& bp = kBackgrounds[11];
  Canvas c(bp.width, bp.height);
  panel(c, 0x2A2E35, 0x1F2227, 42);
  cairo_t* cr = c.cr();
  // The maker's emblem: a V cut into a rounded square.
  rounded_rect(cr, 12, 11, 22, 22, 5);
  cairo_pattern_t* pat = cairo_pattern_create_linear(12, 11, 34, 33);
  cairo_pattern_add_color_stop_rgb(pat, 0, 0.93, 0.94, 0.96);
  cairo_pattern_add_color_stop_rgb(pat, 1, 0.55, 0.58, 0.63);
  cairo_set_source(cr, pat);
  cairo_fill(cr);
  cairo_pattern_destroy(pat);
  set_rgb(cr, hex(0x1F2227));
  cairo_move_to(cr, 16.5, 15.5);
  cairo_line_to(cr, 21, 15.5);
  cairo_line_to(cr, 23, 23.5);
  cairo_line_to(cr, 25, 15.5);
  cairo_line_to(cr, 29.5, 15.5);
  cairo_line_to(cr, 25, 29);
  cairo_line_to(cr, 21, 29);
  cairo_close_path(cr);
  cairo_fill(cr);
  use_font(cr, Face::kBold, 14);
  set_rgb(cr, hex(0xE7EAEE));
  draw_text(cr, "VELMORA", 41, 25, Align::kLeft, 2.2);
  use_font(cr, Face::kCondensed, 9);
  set_rgb(cr, kDimLabel);
  draw_text(cr, "Brakmorph  version 1.24", 41, 38, Align::kLeft);
  bevel(c);
  return finish(bp.name, c);
}

}  // namespace

void add_backgrounds(std::vector<Picture>& out) {
  out.push_back(master());
  out.push_back(top_strip());
  for (int b = 0; b < 4; ++b) {
    out.push_back(band_page(b));
  }
  for (int b = 1; b < 4; ++b) {
    out.push_back(tip_page(b));
  }
  out.push_back(edit_panel());
  out.push_back(presets_panel());
  out.push_back(info_panel());
}

}  // namespace skin
