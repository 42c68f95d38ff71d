#include "previews.h"

#include <cmath>
#include <cstdio>
#include <stdexcept>

namespace skin {

namespace {

constexpr double kPi = 3.14159265358979323846;

// A cairo surface (premultiplied) holding a decoded picture.
class Surface {
 public:
  explicit Surface(const RgbaImage& img)
      : s_(cairo_image_surface_create(CAIRO_FORMAT_ARGB32, img.width, img.height)), w_(img.width), h_(img.height) {
    cairo_surface_flush(s_);
    unsigned char* data = cairo_image_surface_get_data(s_);
    const int stride = cairo_image_surface_get_stride(s_);
    for (int y = 0; y < img.height; ++y) {
      uint32_t* row = reinterpret_cast<uint32_t*>(data + static_cast<size_t>(y) * stride);
      for (int x = 0; x < img.width; ++x) {
        const uint8_t* p = &img.rgba[(static_cast<size_t>(y) * img.width + x) * 4];
        const uint32_t a = p[3];
        const uint32_t r = (p[0] * a + 127) / 255, g = (p[1] * a + 127) / 255, b = (p[2] * a + 127) / 255;
        row[x] = (a << 24) | (r << 16) | (g << 8) | b;
      }
    }
    cairo_surface_mark_dirty(s_);
  }
  ~Surface() { cairo_surface_destroy(s_); }
  Surface(const Surface&) = delete;
  Surface& operator=(const Surface&) = delete;
  cairo_surface_t* get() const { return s_; }
  int width() const { return w_; }
  int height() const { return h_; }

 private:
  cairo_surface_t* s_;
  int w_, h_;
};

RgbaImage decoded(const EncodedSet& set, const std::string& name) {
  auto it = set.find(name);
  if (it == set.end()) {
    throw std::runtime_error("make_skin: preview needs the missing picture " + name);
  }
  return decode_apic(it->second);
}

void paint(cairo_t* cr, const EncodedSet& set, const std::string& name, double x, double y) {
  Surface s(decoded(set, name));
  cairo_set_source_surface(cr, s.get(), x, y);
  cairo_paint(cr);
}

void paint_family(cairo_t* cr, const EncodedSet& set, const std::string& name, FamilyId id, double x, double y) {
  paint(cr, set, name, x + kFamilies[id].anchor_x, y + kFamilies[id].anchor_y);
}

// Rotates a picture about its pivot, clockwise on screen for a positive angle.
void paint_turned(cairo_t* cr, const EncodedSet& set, const std::string& name, FamilyId id, double x, double y,
                  double angle) {
  const Family& f = kFamilies[id];
  Surface s(decoded(set, name));
  cairo_save(cr);
  cairo_translate(cr, x + f.anchor_x + f.pivot_x, y + f.anchor_y + f.pivot_y);
  cairo_rotate(cr, angle);
  cairo_translate(cr, -f.pivot_x, -f.pivot_y);
  cairo_set_source_surface(cr, s.get(), 0, 0);
  cairo_pattern_set_filter(cairo_get_source(cr), CAIRO_FILTER_BILINEAR);
  cairo_paint(cr);
  cairo_restore(cr);
}

// Text in one of the bitmap fonts, right-aligned in a box, as the editor's display shows it.
void font_text_right(cairo_t* cr, const EncodedSet& set, const std::string& font, const std::string& text,
                     double right, double top, const Rgb& colour) {
  const RgbaImage img = decoded(set, font);
  std::vector<int> starts;
  const int marker_row = img.height - 1;
  int previous = -1;
  for (int x = 0; x < img.width; ++x) {
    const int m = img.rgba[(static_cast<size_t>(marker_row) * img.width + x) * 4 + 3];
    if (m != previous) {
      starts.push_back(x);
      previous = m;
    }
  }
  starts.push_back(img.width);
  double width = 0;
  for (unsigned char ch : text) {
    width += starts[ch + 1] - starts[ch];
  }
  Surface s(img);
  double x = right - width;
  for (unsigned char ch : text) {
    const int w = starts[ch + 1] - starts[ch];
    cairo_save(cr);
    cairo_rectangle(cr, x, top, w, img.height - 1);
    cairo_clip(cr);
    set_rgb(cr, colour);
    cairo_mask_surface(cr, s.get(), x - starts[ch], top);
    cairo_restore(cr);
    x += w;
  }
}

struct ShowState {
  bool tips = false;  // bands 2..4 off, their tip pages shown
  bool lit = false;   // lamps and switches on, a knob being turned, markers set
};

void compose_editor(cairo_t* cr, const EncodedSet& set, double oy, const ShowState& state) {
  cairo_save(cr);
  cairo_translate(cr, 0, oy);
  cairo_rectangle(cr, 0, 0, kEditorWidth, kEditorHeight);
  cairo_clip(cr);
  for (int i = 0; i < 12; ++i) {
    const BackgroundPlace& b = kBackgrounds[i];
    const bool tip = i >= 6 && i <= 8;
    const bool hidden_band = i >= 3 && i <= 5 && state.tips;
    if (tip != state.tips && (tip || hidden_band)) {
      continue;
    }
    paint(cr, set, b.name, b.left, b.top);
  }
  auto knob = [&](int x, int y, double value, bool active) {
    paint_family(cr, set, "kn_26_p", kKnobBack, x, y);
    char name[16];
    std::snprintf(name, sizeof name, "kn_26_%02d", knob_frame_for(value));
    paint_family(cr, set, name, kKnobFrame, x, y);
    if (active) {
      paint_family(cr, set, "kn_26_s", kKnobActive, x, y);
    }
  };
  const int on = state.lit ? 4 : 0;
  auto frame = [](const char* stem, int k) { return std::string(stem) + "_" + std::to_string(k); };
  int knob_count = 0;
  for (const Control& c : kMasterControls) {
    switch (c.kind) {
      case kCtlKnob:
        knob(c.x, c.y, state.lit ? 0.15 + 0.12 * knob_count : c.value, state.lit && knob_count == 0);
        ++knob_count;
        break;
      case kCtlFader: {
        const double v = state.tips ? 1.0 : (c.y == 10 ? 0.34 : (c.y == 20 ? 0.6 : 0.83));
        paint_family(cr, set, "fd_09_s", kFaderTrack, c.x, c.y);
        paint_family(cr, set, "fd_09", kFaderCap, c.x + std::floor(v * kFaderTravel + 0.5), c.y);
        break;
      }
      case kCtlWide:
        paint_family(cr, set, frame("ff_16", on), kWideSwitch, c.x, c.y);
        paint_family(cr, set, "ff_16_p", kWideSwitchFront, c.x, c.y);
        break;
      case kCtlStereo:
        paint_family(cr, set, frame("ff_04", on), kStereoSwitch, c.x, c.y);
        break;
      case kCtlDiode:
        paint_family(cr, set, frame("ff_18", on), kClipLamp, c.x, c.y);
        break;
      default:
        paint_family(cr, set, frame("ff_18", on), kLamp, c.x, c.y);
        break;
    }
  }
  for (int b = 0; b < 4; ++b) {
    if (state.tips && b > 0) {
      continue;
    }
    for (const Control& c : kBandControls) {
      const int x = c.kind == kCtlSolo ? kSoloX[b] : c.x + kBandKnobStep * b;
      if (c.kind == kCtlKnob) {
        knob(x, c.y, state.lit ? 0.3 + 0.1 * b : c.value, false);
      } else if (c.kind == kCtlSolo) {
        paint_family(cr, set, frame("ff_17", state.lit && b == 0 ? 4 : 0), kSoloSwitch, x, c.y);
      } else if (c.kind == kCtlMeter) {
        const std::string stem = "vn_0" + std::to_string(b + 1);
        const double position = state.lit ? 0.62 + 0.05 * b : 0.0;
        paint_family(cr, set, stem + "_p", kMeterFace, x, c.y);
        cairo_save(cr);
        const Family& f = kFamilies[kMeterFace];
        cairo_rectangle(cr, x + f.anchor_x, c.y + f.anchor_y, f.width, f.height);
        cairo_clip(cr);
        paint_turned(cr, set, stem, kNeedle, x, c.y, 2 * kPi * (position * kNeedleSpan + kNeedleOffset));
        cairo_restore(cr);
        paint_family(cr, set, stem + "_o", kMeterCover, x, c.y);
      }
    }
  }
  for (const Control& c : kPanelControls) {
    if (c.kind == kCtlProgram) {
      for (int i = 0; i < 8; ++i) {
        const int k = state.lit && i == 2 ? 4 : 0;
        paint(cr, set, "pb_" + std::to_string(11 + i) + "_" + std::to_string(k), program_button_x(i),
              program_button_y(i));
      }
    } else if (c.kind == kCtlPanelLamp) {
      paint_family(cr, set, frame("ff_18", state.lit && c.label[0] == 0 ? 4 : 0), kLamp, c.x, c.y);
    } else if (c.kind == kCtlSmallKnob) {
      paint_family(cr, set, "kn_08", kSmallKnob, c.x, c.y);
      const Family& k = kFamilies[kSmallKnob];
      const double cx = c.x + k.anchor_x + k.pivot_x, cy = c.y + k.anchor_y + k.pivot_y;
      const double a = 2 * kPi * (0.625 - 0.75 * c.value);
      const Family& p = kFamilies[kSmallKnobPointer];
      paint(cr, set, "kn_08_spn", cx + 8 * std::cos(a) - p.pivot_x, cy - 8 * std::sin(a) - p.pivot_y);
    } else if (c.kind == kCtlDisplay) {
      font_text_right(cr, set, "font_04", state.lit ? "2.5" : "1", c.x, c.y, hex(0x00FFFF));
    } else if (c.kind == kCtlSetup) {
      paint(cr, set, state.lit ? "pb_53_1" : "pb_53_0", c.x, c.y);
    }
  }
  if (state.lit) {
    paint_family(cr, set, "tl_01_0", kMarker, kBandControls[3].x, kBandControls[3].y);
    paint_family(cr, set, "tl_01_1", kMarker, kBandControls[4].x, kBandControls[4].y);
  }
  cairo_restore(cr);
}

void write_png(cairo_surface_t* s, const std::string& path) {
  if (cairo_surface_write_to_png(s, path.c_str()) != CAIRO_STATUS_SUCCESS) {
    throw std::runtime_error("make_skin: cannot write " + path);
  }
}

}  // namespace

void write_editor_preview(const EncodedSet& set, const std::string& path) {
  const int gap = 10;
  Canvas canvas(kEditorWidth, kEditorHeight * 2 + gap);
  cairo_t* cr = canvas.cr();
  cairo_set_source_rgb(cr, 0.08, 0.08, 0.09);
  cairo_paint(cr);
  compose_editor(cr, set, 0, ShowState{false, false});
  compose_editor(cr, set, kEditorHeight + gap, ShowState{true, true});
  write_png(canvas.surface(), path);
}

void write_contact_sheet(const std::vector<Picture>& pictures, const EncodedSet& set, const std::string& path) {
  const int sheet_width = 1240, pad = 8, label_h = 13;
  struct Cell {
    const Picture* pic;
    int x, y, w, h, zoom;
  };
  // Flow layout: small pictures at twice their size so their detail shows.
  Canvas probe(1, 1);
  use_font(probe.cr(), Face::kCondensed, 9);
  std::vector<Cell> cells;
  int x = pad, y = pad, row_h = 0;
  for (const Picture& p : pictures) {
    const int zoom = (p.image.width <= 60 && p.image.height <= 64) ? 2 : 1;
    int w = p.image.width * zoom, h = p.image.height * zoom;
    if (p.kind == kApicUnicolorFont) {
      w = sheet_width - 2 * pad;
      h = (p.image.height + 4) * ((p.image.width + w - 1) / w);
    }
    const int cw = std::max(w, static_cast<int>(text_width(probe.cr(), p.name)) + 2);
    if (x + cw > sheet_width - pad) {
      x = pad;
      y += row_h + label_h + pad;
      row_h = 0;
    }
    cells.push_back(Cell{&p, x, y, w, h, zoom});
    x += cw + pad;
    row_h = std::max(row_h, h);
  }
  const int height = y + row_h + label_h + pad;
  Canvas canvas(sheet_width, height);
  cairo_t* cr = canvas.cr();
  cairo_set_source_rgb(cr, 0.11, 0.115, 0.125);
  cairo_paint(cr);
  for (const Cell& c : cells) {
    const RgbaImage img = decoded(set, c.pic->name);
    Surface s(img);
    // A checker shows what is transparent.
    for (int cy = 0; cy < c.h; cy += 6) {
      for (int cx = 0; cx < c.w; cx += 6) {
        const bool dark = ((cx / 6) + (cy / 6)) % 2 == 0;
        cairo_set_source_rgb(cr, dark ? 0.16 : 0.21, dark ? 0.165 : 0.215, dark ? 0.175 : 0.225);
        cairo_rectangle(cr, c.x + cx, c.y + cy, std::min(6, c.w - cx), std::min(6, c.h - cy));
        cairo_fill(cr);
      }
    }
    if (c.pic->kind == kApicUnicolorFont) {
      const int w = c.w;
      for (int part = 0; part * w < img.width; ++part) {
        cairo_save(cr);
        const double top = c.y + part * (img.height + 4);
        cairo_rectangle(cr, c.x, top, std::min(w, img.width - part * w), img.height);
        cairo_clip(cr);
        cairo_set_source_rgb(cr, 0.95, 0.95, 0.95);
        cairo_mask_surface(cr, s.get(), c.x - part * w, top);
        cairo_restore(cr);
      }
    } else {
      cairo_save(cr);
      cairo_translate(cr, c.x, c.y);
      cairo_scale(cr, c.zoom, c.zoom);
      cairo_set_source_surface(cr, s.get(), 0, 0);
      cairo_pattern_set_filter(cairo_get_source(cr), CAIRO_FILTER_NEAREST);
      cairo_paint(cr);
      cairo_restore(cr);
    }
    use_font(cr, Face::kCondensed, 9);
    cairo_set_source_rgb(cr, 0.78, 0.8, 0.84);
    draw_text(cr, c.pic->name, c.x, c.y + c.h + 10, Align::kLeft);
  }
  write_png(canvas.surface(), path);
}

}  // namespace skin
