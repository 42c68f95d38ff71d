// The control pictures: knob frames, fader, switches, lamps, meters, buttons, markers.
#include <cmath>
#include <cstdio>
#include <string>

#include "pictures.h"

namespace skin {

namespace {

constexpr double kPi = 3.14159265358979323846;

Picture make(const std::string& name, FamilyId family, const Canvas& canvas, uint32_t flag = kFlagDefault) {
  Picture p;
  p.name = name;
  p.kind = kApicAlpha;
  p.flag = flag;
  p.image = canvas.to_rgba();
  p.family = family;
  return p;
}

void circle(cairo_t* cr, double cx, double cy, double r) {
  cairo_new_sub_path(cr);
  cairo_arc(cr, cx, cy, r, 0, 2 * kPi);
}

void linear_fill(cairo_t* cr, double x0, double y0, double x1, double y1, const Rgb& a, const Rgb& b,
                 double alpha = 1.0) {
  cairo_pattern_t* pat = cairo_pattern_create_linear(x0, y0, x1, y1);
  cairo_pattern_add_color_stop_rgba(pat, 0, a.r, a.g, a.b, alpha);
  cairo_pattern_add_color_stop_rgba(pat, 1, b.r, b.g, b.b, alpha);
  cairo_set_source(cr, pat);
  cairo_pattern_destroy(pat);
}

void soft_shadow(cairo_t* cr, double cx, double cy, double r0, double r1, double alpha) {
  cairo_pattern_t* pat = cairo_pattern_create_radial(cx, cy, r0, cx, cy, r1);
  cairo_pattern_add_color_stop_rgba(pat, 0, 0, 0, 0, alpha);
  cairo_pattern_add_color_stop_rgba(pat, 1, 0, 0, 0, 0);
  cairo_set_source(cr, pat);
  circle(cr, cx, cy, r1);
  cairo_fill(cr);
  cairo_pattern_destroy(pat);
}

// A machined knob cap with a knurled skirt; `turns` is the pointer direction,
// counter-clockwise from the right. The light stays at the top left whatever the angle.
void paint_knob(cairo_t* cr, double cx, double cy, double skirt, double cap, double turns, bool pointer) {
  const double a = 2 * kPi * turns;
  // Skirt with knurling that turns with the knob.
  cairo_pattern_t* body = cairo_pattern_create_radial(cx - 3, cy - 4, 1, cx, cy, skirt);
  cairo_pattern_add_color_stop_rgb(body, 0, 0.20, 0.21, 0.24);
  cairo_pattern_add_color_stop_rgb(body, 1, 0.07, 0.075, 0.085);
  cairo_set_source(cr, body);
  circle(cr, cx, cy, skirt);
  cairo_fill(cr);
  cairo_pattern_destroy(body);
  const int grooves = 36;
  cairo_set_line_width(cr, 0.7);
  for (int k = 0; k < grooves; ++k) {
    const double g = a + 2 * kPi * k / grooves;
    const double lit = 0.5 + 0.5 * std::cos(g - 2.35);  // brighter towards the top left
    cairo_set_source_rgba(cr, 1, 1, 1, 0.06 + 0.16 * lit);
    cairo_move_to(cr, cx + (cap + 0.8) * std::cos(g), cy - (cap + 0.8) * std::sin(g));
    cairo_line_to(cr, cx + (skirt - 0.4) * std::cos(g), cy - (skirt - 0.4) * std::sin(g));
    cairo_stroke(cr);
  }
  // Rim: lit at the top left, dark at the bottom right.
  cairo_set_line_width(cr, 0.8);
  linear_fill(cr, cx - skirt, cy - skirt, cx + skirt, cy + skirt, hex(0x8A929C), hex(0x08090A));
  circle(cr, cx, cy, skirt - 0.4);
  cairo_stroke(cr);
  // Cap: brushed dome.
  linear_fill(cr, cx - cap, cy - cap, cx + cap * 0.8, cy + cap, hex(0x5C636D), hex(0x1E2126));
  circle(cr, cx, cy, cap);
  cairo_fill(cr);
  for (double r = 1.5; r < cap; r += 1.5) {
    cairo_set_line_width(cr, 0.5);
    cairo_set_source_rgba(cr, 1, 1, 1, (static_cast<int>(r * 2) % 2) ? 0.035 : 0.0);
    circle(cr, cx, cy, r);
    cairo_stroke(cr);
  }
  cairo_pattern_t* highlight = cairo_pattern_create_radial(cx - cap * 0.35, cy - cap * 0.45, 0, cx - cap * 0.35,
                                                      cy - cap * 0.45, cap * 0.95);
  cairo_pattern_add_color_stop_rgba(highlight, 0, 1, 1, 1, 0.26);
  cairo_pattern_add_color_stop_rgba(highlight, 1, 1, 1, 1, 0);
  cairo_set_source(cr, highlight);
  circle(cr, cx, cy, cap);
  cairo_fill(cr);
  cairo_pattern_destroy(highlight);
  cairo_set_line_width(cr, 0.7);
  linear_fill(cr, cx - cap, cy - cap, cx + cap, cy + cap, hex(0xA0A8B2), hex(0x101215), 0.9);
  circle(cr, cx, cy, cap - 0.35);
  cairo_stroke(cr);
  if (!pointer) {
    return;
  }
  const double dx = std::cos(a), dy = -std::sin(a);
  cairo_set_line_cap(cr, CAIRO_LINE_CAP_ROUND);
  cairo_set_line_width(cr, 2.6);
  cairo_set_source_rgba(cr, 0, 0, 0, 0.55);
  cairo_move_to(cr, cx + dx * 3.2, cy + dy * 3.2);
  cairo_line_to(cr, cx + dx * (skirt - 1.2), cy + dy * (skirt - 1.2));
  cairo_stroke(cr);
  cairo_set_line_width(cr, 1.5);
  set_rgb(cr, hex(0xF6F8FB));
  cairo_move_to(cr, cx + dx * 3.6, cy + dy * 3.6);
  cairo_line_to(cr, cx + dx * (skirt - 1.4), cy + dy * (skirt - 1.4));
  cairo_stroke(cr);
}

void add_knob(std::vector<Picture>& out) {
  const Family& f = kFamilies[kKnobFrame];
  for (int i = 0; i < kKnobFrames; ++i) {
    Canvas c(f.width, f.height);
    const double turns = kKnobFrame0Turns + i * kKnobTurnsCovered / kKnobFrames;
    paint_knob(c.cr(), f.pivot_x, f.pivot_y, 13.6, 10.2, turns, true);
    char name[16];
    std::snprintf(name, sizeof name, "kn_26_%02d", i);
    out.push_back(make(name, kKnobFrame, c));
  }
  {
    const Family& b = kFamilies[kKnobBack];
    Canvas c(b.width, b.height);
    cairo_t* cr = c.cr();
    soft_shadow(cr, b.pivot_x + 0.6, b.pivot_y + 1.4, 12.5, 17.8, 0.75);
    set_rgb(cr, hex(0x0B0C0E), 0.95);
    circle(cr, b.pivot_x, b.pivot_y, 14.7);
    cairo_fill(cr);
    cairo_set_line_width(cr, 0.8);
    linear_fill(cr, 0, b.height, b.width, 0, hex(0x4A515A), hex(0x000000), 0.8);
    circle(cr, b.pivot_x, b.pivot_y, 15.0);
    cairo_stroke(cr);
    out.push_back(make("kn_26_p", kKnobBack, c));
  }
  {
    const Family& s = kFamilies[kKnobActive];
    Canvas c(s.width, s.height);
    cairo_t* cr = c.cr();
    cairo_set_line_width(cr, 2.2);
    cairo_set_source_rgba(cr, 1, 1, 1, 0.16);
    circle(cr, s.pivot_x, s.pivot_y, 16.6);
    cairo_stroke(cr);
    cairo_set_line_width(cr, 1.1);
    cairo_set_source_rgba(cr, 1, 1, 1, 0.7);
    circle(cr, s.pivot_x, s.pivot_y, 15.4);
    cairo_stroke(cr);
    out.push_back(make("kn_26_s", kKnobActive, c));
  }
}

double split_x(double hz) { return 4.5 + kFaderTravel * std::log2(hz / 20.0) / 10.0; }

void add_fader(std::vector<Picture>& out) {
  {
    const Family& f = kFamilies[kFaderCap];
    Canvas c(f.width, f.height);
    cairo_t* cr = c.cr();
    rounded_rect(cr, 0.5, 0.5, f.width - 1, f.height - 1, 1.5);
    linear_fill(cr, 0, 0, 0, f.height, hex(0xE4E8EE), hex(0x7F8690));
    cairo_fill_preserve(cr);
    cairo_set_line_width(cr, 1.0);
    set_rgb(cr, hex(0x0A0B0D));
    cairo_stroke(cr);
    cairo_set_line_width(cr, 1.0);
    set_rgb(cr, hex(0x16181C));
    cairo_move_to(cr, f.pivot_x, 1.5);
    cairo_line_to(cr, f.pivot_x, f.height - 1.5);
    cairo_stroke(cr);
    out.push_back(make("fd_09", kFaderCap, c));
  }
  const Family& t = kFamilies[kFaderTrack];
  Canvas c(t.width, t.height);
  cairo_t* cr = c.cr();
  // Recessed slot along the travel.
  rounded_rect(cr, 1, 2, t.width - 2, 3, 1.5);
  set_rgb(cr, hex(0x07080A));
  cairo_fill(cr);
  cairo_set_line_width(cr, 1.0);
  cairo_set_source_rgba(cr, 1, 1, 1, 0.13);
  cairo_move_to(cr, 2, 5.5);
  cairo_line_to(cr, t.width - 2, 5.5);
  cairo_stroke(cr);
  cairo_set_source_rgba(cr, 0, 0, 0, 0.5);
  cairo_move_to(cr, 2, 1.5);
  cairo_line_to(cr, t.width - 2, 1.5);
  cairo_stroke(cr);
  // Frequency marks: decades long, the steps between them short.
  const double marks[] = {20, 50, 100, 200, 500, 1000, 2000, 5000, 10000, 20000};
  for (double hz : marks) {
    const bool decade = hz == 100 || hz == 1000 || hz == 10000;
    const double x = std::floor(split_x(hz)) + 0.5;
    cairo_set_source_rgba(cr, 0.75, 0.78, 0.82, decade ? 0.85 : 0.45);
    cairo_move_to(cr, x, 0);
    cairo_line_to(cr, x, decade ? 2 : 1);
    cairo_stroke(cr);
    if (decade) {
      cairo_move_to(cr, x, 5.5);
      cairo_line_to(cr, x, 7);
      cairo_stroke(cr);
    }
  }
  out.push_back(make("fd_09_s", kFaderTrack, c));
}

// Lamp lens: level 0 (dark) .. 1 (lit).
void paint_lamp(cairo_t* cr, double cx, double cy, double level, const Rgb& lit) {
  linear_fill(cr, cx, cy - 8, cx, cy + 8, hex(0xA7AEB8), hex(0x1E2024));
  circle(cr, cx, cy, 7.9);
  cairo_fill(cr);
  set_rgb(cr, hex(0x0A0A0B));
  circle(cr, cx, cy, 6.4);
  cairo_fill(cr);
  const Rgb dark = mix(scale(lit, 0.22), hex(0x100404), 0.4);
  const Rgb edge = mix(dark, lit, level);
  const Rgb core = mix(scale(lit, 0.32), mix(lit, hex(0xFFF2E0), 0.55), level);
  cairo_pattern_t* lens = cairo_pattern_create_radial(cx - 0.6, cy - 0.8, 0.5, cx, cy, 5.7);
  cairo_pattern_add_color_stop_rgb(lens, 0, core.r, core.g, core.b);
  cairo_pattern_add_color_stop_rgb(lens, 1, edge.r * 0.8, edge.g * 0.8, edge.b * 0.8);
  cairo_set_source(cr, lens);
  circle(cr, cx, cy, 5.6);
  cairo_fill(cr);
  cairo_pattern_destroy(lens);
  cairo_pattern_t* highlight = cairo_pattern_create_radial(cx - 2, cy - 2.4, 0, cx - 2, cy - 2.4, 3.0);
  cairo_pattern_add_color_stop_rgba(highlight, 0, 1, 1, 1, 0.55);
  cairo_pattern_add_color_stop_rgba(highlight, 1, 1, 1, 1, 0);
  cairo_set_source(cr, highlight);
  circle(cr, cx, cy, 5.6);
  cairo_fill(cr);
  cairo_pattern_destroy(highlight);
}

void add_switches(std::vector<Picture>& out) {
  const Rgb master = hex(kMasterAccent);
  for (int k = 0; k < 5; ++k) {
    const double level = k / 4.0;
    char name[16];
    {  // Stereo boost: a square key whose face lights up.
      const Family& f = kFamilies[kStereoSwitch];
      Canvas c(f.width, f.height);
      cairo_t* cr = c.cr();
      rounded_rect(cr, 0.5, 0.5, 16, 16, 3);
      linear_fill(cr, 0, 0, 0, 17, hex(0x4B525B), hex(0x0C0D0F));
      cairo_fill(cr);
      rounded_rect(cr, 2, 2, 13, 13, 2);
      linear_fill(cr, 0, 2, 0, 15, mix(hex(0x363B42), master, level * 0.85), mix(hex(0x1E2126), scale(master, 0.6), level));
      cairo_fill(cr);
      cairo_pattern_t* glow = cairo_pattern_create_radial(8.5, 8.5, 0, 8.5, 8.5, 6);
      cairo_pattern_add_color_stop_rgba(glow, 0, 1, 0.92, 0.9, 0.75 * level);
      cairo_pattern_add_color_stop_rgba(glow, 1, 1, 0.9, 0.9, 0);
      cairo_set_source(cr, glow);
      rounded_rect(cr, 2, 2, 13, 13, 2);
      cairo_fill(cr);
      cairo_pattern_destroy(glow);
      cairo_set_line_width(cr, 1);
      cairo_set_source_rgba(cr, 1, 1, 1, 0.18);
      cairo_move_to(cr, 3, 2.5);
      cairo_line_to(cr, 14, 2.5);
      cairo_stroke(cr);
      std::snprintf(name, sizeof name, "ff_04_%d", k);
      out.push_back(make(name, kStereoSwitch, c));
    }
    {  // Oversampling: a wide key with an LED bar at its left.
      const Family& f = kFamilies[kWideSwitch];
      Canvas c(f.width, f.height);
      cairo_t* cr = c.cr();
      rounded_rect(cr, 0.5, 0.5, 56, 23, 3.5);
      linear_fill(cr, 0, 0, 0, 24, hex(0x4E555F), hex(0x0B0C0E));
      cairo_fill(cr);
      rounded_rect(cr, 2, 2, 53, 20, 2.5);
      linear_fill(cr, 0, 2, 0, 22, hex(0x3A4048), hex(0x1F2227));
      cairo_fill(cr);
      rounded_rect(cr, 6, 6, 4, 12, 1.5);
      set_rgb(cr, hex(0x080809));
      cairo_fill(cr);
      rounded_rect(cr, 6.5, 6.5, 3, 11, 1.2);
      set_rgb(cr, mix(scale(master, 0.25), mix(master, hex(0xFFE6E0), 0.35), level));
      cairo_fill(cr);
      if (level > 0) {
        cairo_pattern_t* glow = cairo_pattern_create_radial(8, 12, 1, 8, 12, 9);
        cairo_pattern_add_color_stop_rgba(glow, 0, master.r, master.g, master.b, 0.45 * level);
        cairo_pattern_add_color_stop_rgba(glow, 1, master.r, master.g, master.b, 0);
        cairo_set_source(cr, glow);
        rounded_rect(cr, 2, 2, 53, 20, 2.5);
        cairo_fill(cr);
        cairo_pattern_destroy(glow);
      }
      std::snprintf(name, sizeof name, "ff_16_%d", k);
      out.push_back(make(name, kWideSwitch, c));
    }
    {  // Solo: a pill key that glows yellow.
      const Family& f = kFamilies[kSoloSwitch];
      Canvas c(f.width, f.height);
      cairo_t* cr = c.cr();
      rounded_rect(cr, 0.5, 0.5, 30, 17, 4);
      linear_fill(cr, 0, 0, 0, 18, hex(0x4B525B), hex(0x0B0C0E));
      cairo_fill(cr);
      const Rgb lit = hex(0xF2C12E);
      rounded_rect(cr, 2, 2, 27, 14, 3);
      linear_fill(cr, 0, 2, 0, 16, mix(hex(0x383D45), mix(lit, hex(0xFFF4C8), 0.3), level),
                  mix(hex(0x1F2227), scale(lit, 0.75), level));
      cairo_fill(cr);
      use_font(cr, Face::kCondensedBold, 9);
      set_rgb(cr, mix(hex(0xA3AAB4), hex(0x2A1E00), level));
      draw_text(cr, "SOLO", 15.5, 12.5, Align::kCentre, 0.6);
      std::snprintf(name, sizeof name, "ff_17_%d", k);
      out.push_back(make(name, kSoloSwitch, c));
    }
    {
      const Family& f = kFamilies[kLamp];
      Canvas c(f.width, f.height);
      paint_lamp(c.cr(), f.pivot_x, f.pivot_y, level, hex(0xFF3B2F));
      std::snprintf(name, sizeof name, "ff_18_%d", k);
      out.push_back(make(name, kLamp, c, kFlagOne));
    }
  }
  const Family& f = kFamilies[kWideSwitchFront];
  Canvas c(f.width, f.height);
  cairo_t* cr = c.cr();
  use_font(cr, Face::kBold, 11);
  set_rgb(cr, hex(0xE8ECF1), 0.92);
  draw_text(cr, "4\xC3\x97", 33, 16, Align::kCentre);
  use_font(cr, Face::kCondensedBold, 7.5);
  set_rgb(cr, hex(0xAEB5BF), 0.9);
  draw_text(cr, "OS", 47.5, 16, Align::kCentre);
  // Glass sheen over the upper half of the key.
  rounded_rect(cr, 2, 2, 53, 9, 2.5);
  cairo_set_source_rgba(cr, 1, 1, 1, 0.07);
  cairo_fill(cr);
  out.push_back(make("ff_16_p", kWideSwitchFront, c));
}

// Screen angle of a meter position, clockwise from straight up.
double needle_angle(double position) { return 2 * kPi * (position * kNeedleSpan + kNeedleOffset); }
double db_position(double db) { return (db + 30) * 0.025; }

void add_meters(std::vector<Picture>& out) {
  for (int b = 0; b < 4; ++b) {
    const Rgb accent = hex(kBandAccent[b]);
    const Family& face = kFamilies[kMeterFace];
    const double px = face.pivot_x, py = face.pivot_y;
    char name[16];
    {
      Canvas c(face.width, face.height);
      cairo_t* cr = c.cr();
      rounded_rect(cr, 0, 0, face.width, face.height, 3);
      cairo_pattern_t* bg = cairo_pattern_create_radial(px, py - 40, 2, px, py - 30, 40);
      cairo_pattern_add_color_stop_rgb(bg, 0, 0.16, 0.17, 0.19);
      cairo_pattern_add_color_stop_rgb(bg, 1, 0.06, 0.065, 0.075);
      cairo_set_source(cr, bg);
      cairo_fill(cr);
      cairo_pattern_destroy(bg);
      auto at = [&](double db, double r, double* x, double* y) {
        const double a = needle_angle(db_position(db));
        *x = px + r * std::sin(a);
        *y = py - r * std::cos(a);
      };
      const double arc_r = 33;
      // The scale arc: band colour below 0 dB, red above.
      cairo_set_line_width(cr, 1.6);
      const double a0 = needle_angle(0) - kPi / 2, a1 = needle_angle(db_position(0)) - kPi / 2,
                   a2 = needle_angle(1) - kPi / 2;
      set_rgb(cr, accent, 0.85);
      cairo_arc(cr, px, py, arc_r, a0, a1);
      cairo_stroke(cr);
      set_rgb(cr, hex(0xFF4436));
      cairo_set_line_width(cr, 2.6);
      cairo_arc(cr, px, py, arc_r + 0.5, a1, a2);
      cairo_stroke(cr);
      const double ticks[] = {-30, -20, -15, -10, -7, -5, -3, -2, -1, 0, 1, 2, 3, 5, 10};
      cairo_set_line_width(cr, 0.9);
      for (double db : ticks) {
        const bool major = db == -20 || db == -10 || db == -5 || db == 0 || db == 5;
        double x0, y0, x1, y1;
        at(db, arc_r + 0.8, &x0, &y0);
        at(db, arc_r + (major ? 5.5 : 3.2), &x1, &y1);
        set_rgb(cr, db > 0 ? hex(0xFF7A6E) : hex(0xD8DDE3), major ? 0.95 : 0.6);
        cairo_move_to(cr, x0, y0);
        cairo_line_to(cr, x1, y1);
        cairo_stroke(cr);
      }
      use_font(cr, Face::kCondensedBold, 7);
      const struct { double db; const char* text; } numbers[] = {{-20, "-20"}, {-10, "-10"}, {-5, "-5"}};
      for (const auto& n : numbers) {
        double x, y;
        at(n.db, arc_r + 10.5, &x, &y);
        set_rgb(cr, hex(0xC4CAD2), 0.95);
        draw_text(cr, n.text, x, y + 2.5, Align::kCentre);
      }
      set_rgb(cr, accent, 0.9);
      draw_text(cr, "dB", 4, 9, Align::kLeft);
      std::snprintf(name, sizeof name, "vn_0%d_p", b + 1);
      out.push_back(make(name, kMeterFace, c));
    }
    {
      const Family& n = kFamilies[kNeedle];
      Canvas c(n.width, n.height);
      cairo_t* cr = c.cr();
      cairo_set_line_cap(cr, CAIRO_LINE_CAP_ROUND);
      cairo_set_line_width(cr, 2.2);
      cairo_set_source_rgba(cr, 0, 0, 0, 0.35);
      cairo_move_to(cr, n.pivot_x, n.pivot_y - 25);
      cairo_line_to(cr, n.pivot_x, n.pivot_y - 54);
      cairo_stroke(cr);
      cairo_set_line_width(cr, 1.2);
      set_rgb(cr, mix(accent, hex(0xFFFFFF), 0.45));
      cairo_move_to(cr, n.pivot_x, n.pivot_y - 25);
      cairo_line_to(cr, n.pivot_x, n.pivot_y - 54);
      cairo_stroke(cr);
      std::snprintf(name, sizeof name, "vn_0%d", b + 1);
      out.push_back(make(name, kNeedle, c));
    }
    {
      const Family& cv = kFamilies[kMeterCover];
      Canvas c(cv.width, cv.height);
      cairo_t* cr = c.cr();
      // Hub housing that hides the needle's root.
      circle(cr, px, py, 26.5);
      linear_fill(cr, 0, 32, 0, 37, hex(0x3A4048), hex(0x15171A));
      cairo_fill(cr);
      cairo_set_line_width(cr, 1);
      set_rgb(cr, accent, 0.9);
      cairo_arc(cr, px, py, 26.2, -kPi / 2 - 0.42, -kPi / 2 + 0.42);
      cairo_stroke(cr);
      // Glass sheen and bezel.
      cairo_move_to(cr, 2, 2);
      cairo_line_to(cr, 44, 2);
      cairo_line_to(cr, 2, 20);
      cairo_close_path(cr);
      cairo_set_source_rgba(cr, 1, 1, 1, 0.05);
      cairo_fill(cr);
      cairo_set_line_width(cr, 2);
      rounded_rect(cr, 1, 1, cv.width - 2, cv.height - 2, 3);
      linear_fill(cr, 0, 0, 0, cv.height, hex(0x07080A), hex(0x4A515B));
      cairo_stroke(cr);
      std::snprintf(name, sizeof name, "vn_0%d_o", b + 1);
      out.push_back(make(name, kMeterCover, c));
    }
  }
}

void add_panel_pictures(std::vector<Picture>& out) {
  const Rgb accent = hex(kPanelAccent);
  for (int m = 0; m < 2; ++m) {
    const Family& f = kFamilies[kMarker];
    Canvas c(f.width, f.height);
    cairo_t* cr = c.cr();
    if (m == 0) {
      set_rgb(cr, hex(0x0A0B0D), 0.75);
      circle(cr, 5.5, 5.5, 4.8);
      cairo_fill(cr);
      cairo_set_line_width(cr, 1.5);
      set_rgb(cr, accent);
      circle(cr, 5.5, 5.5, 4.0);
      cairo_stroke(cr);
    } else {
      set_rgb(cr, hex(0x0A0B0D), 0.8);
      circle(cr, 5.5, 5.5, 5.2);
      cairo_fill(cr);
      set_rgb(cr, hex(0xFFB020));
      circle(cr, 5.5, 5.5, 4.3);
      cairo_fill(cr);
      set_rgb(cr, hex(0xFFF4D6));
      circle(cr, 5.5, 5.5, 1.6);
      cairo_fill(cr);
    }
    out.push_back(make(m == 0 ? "tl_01_0" : "tl_01_1", kMarker, c));
  }
  for (int i = 0; i < 8; ++i) {
    for (int k = 0; k < 5; ++k) {
      const double level = k / 4.0;
      const Family& f = kFamilies[kProgramButton];
      Canvas c(f.width, f.height);
      cairo_t* cr = c.cr();
      rounded_rect(cr, 0, 0, 13, 13, 2.5);
      linear_fill(cr, 0, 0, 0, 13, hex(0x4D545E), hex(0x0A0B0D));
      cairo_fill(cr);
      rounded_rect(cr, 1.5, 1.5, 10, 10, 1.5);
      linear_fill(cr, 0, 1.5, 0, 11.5, mix(hex(0x3A4048), mix(accent, hex(0xE0FBFF), 0.4), level),
                  mix(hex(0x22262B), scale(accent, 0.7), level));
      cairo_fill(cr);
      use_font(cr, Face::kBold, 8);
      // The digit flips from light to dark once the face is bright enough to carry it.
      set_rgb(cr, level < 0.6 ? mix(hex(0xC2C8D0), hex(0xFFFFFF), level) : hex(0x05232A));
      draw_text(cr, std::to_string(i + 1), 6.5, 9.8, Align::kCentre);
      char name[16];
      std::snprintf(name, sizeof name, "pb_%d_%d", 11 + i, k);
      out.push_back(make(name, kProgramButton, c, kFlagOne));
    }
  }
  for (int pressed = 0; pressed < 2; ++pressed) {
    const Family& f = kFamilies[kSetupButton];
    Canvas c(f.width, f.height);
    cairo_t* cr = c.cr();
    rounded_rect(cr, 0.5, 0.5, 56, 12.5, 3);
    linear_fill(cr, 0, 0, 0, 13, hex(0x4D545E), hex(0x0A0B0D));
    cairo_fill(cr);
    rounded_rect(cr, 1.5, 1.5, 54, 10.5, 2.2);
    if (pressed) {
      linear_fill(cr, 0, 1.5, 0, 12, hex(0x16191D), hex(0x262A30));
    } else {
      linear_fill(cr, 0, 1.5, 0, 12, hex(0x3C424A), hex(0x23272C));
    }
    cairo_fill(cr);
    use_font(cr, Face::kCondensedBold, 8.5);
    set_rgb(cr, pressed ? accent : hex(0xC9CED6));
    draw_text(cr, "SETUP", 28.5, 10 + pressed, Align::kCentre, 1.2);
    out.push_back(make(pressed ? "pb_53_1" : "pb_53_0", kSetupButton, c, kFlagOne));
  }
  {
    const Family& f = kFamilies[kSmallKnob];
    Canvas c(f.width, f.height);
    soft_shadow(c.cr(), f.pivot_x + 0.5, f.pivot_y + 1.2, 9.5, 13.4, 0.7);
    paint_knob(c.cr(), f.pivot_x, f.pivot_y, 11.2, 8.6, 0, false);
    out.push_back(make("kn_08", kSmallKnob, c, kFlagOne));
  }
  {
    const Family& f = kFamilies[kSmallKnobPointer];
    Canvas c(f.width, f.height);
    cairo_t* cr = c.cr();
    set_rgb(cr, accent, 0.35);
    circle(cr, 2.5, 2.5, 2.5);
    cairo_fill(cr);
    set_rgb(cr, mix(accent, hex(0xFFFFFF), 0.3));
    circle(cr, 2.5, 2.5, 1.6);
    cairo_fill(cr);
    out.push_back(make("kn_08_spn", kSmallKnobPointer, c, kFlagOne));
  }
}

}  // namespace

void add_control_pictures(std::vector<Picture>& out) {
  add_knob(out);
  add_fader(out);
  add_switches(out);
  add_meters(out);
  add_panel_pictures(out);
}

}  // namespace skin
