#include "paint.h"

#include <cairo-ft.h>
#include <ft2build.h>
#include FT_FREETYPE_H

#include <cmath>
#include <stdexcept>

namespace skin {

Rgb hex(uint32_t v) {
  return Rgb{((v >> 16) & 255) / 255.0, ((v >> 8) & 255) / 255.0, (v & 255) / 255.0};
}

Rgb mix(const Rgb& a, const Rgb& b, double t) {
  return Rgb{a.r + (b.r - a.r) * t, a.g + (b.g - a.g) * t, a.b + (b.b - a.b) * t};
}

Rgb scale(const Rgb& c, double f) {
  auto clamp = [](double v) { return v < 0 ? 0 : (v > 1 ? 1 : v); };
  return Rgb{clamp(c.r * f), clamp(c.g * f), clamp(c.b * f)};
}

void set_rgb(cairo_t* cr, const Rgb& c, double alpha) { cairo_set_source_rgba(cr, c.r, c.g, c.b, alpha); }

Canvas::Canvas(int width, int height)
    : width_(width),
      height_(height),
      surface_(cairo_image_surface_create(CAIRO_FORMAT_ARGB32, width, height)),
      cr_(cairo_create(surface_)) {
  cairo_set_antialias(cr_, CAIRO_ANTIALIAS_GRAY);
}

Canvas::~Canvas() {
  cairo_destroy(cr_);
  cairo_surface_destroy(surface_);
}

RgbaImage Canvas::to_rgba() const {
  cairo_surface_flush(surface_);
  RgbaImage out;
  out.width = width_;
  out.height = height_;
  out.rgba.resize(static_cast<size_t>(width_) * height_ * 4);
  const unsigned char* data = cairo_image_surface_get_data(surface_);
  const int stride = cairo_image_surface_get_stride(surface_);
  for (int y = 0; y < height_; ++y) {
    const uint32_t* row = reinterpret_cast<const uint32_t*>(data + static_cast<size_t>(y) * stride);
    for (int x = 0; x < width_; ++x) {
      const uint32_t p = row[x];
      const unsigned a = p >> 24;
      unsigned r = (p >> 16) & 255, g = (p >> 8) & 255, b = p & 255;
      if (a != 0 && a != 255) {
        // Undo the premultiplication, rounding to nearest.
        r = (r * 255 + a / 2) / a;
        g = (g * 255 + a / 2) / a;
        b = (b * 255 + a / 2) / a;
      } else if (a == 0) {
        r = g = b = 0;
      }
      uint8_t* d = &out.rgba[(static_cast<size_t>(y) * width_ + x) * 4];
      d[0] = static_cast<uint8_t>(r > 255 ? 255 : r);
      d[1] = static_cast<uint8_t>(g > 255 ? 255 : g);
      d[2] = static_cast<uint8_t>(b > 255 ? 255 : b);
      d[3] = static_cast<uint8_t>(a);
    }
  }
  return out;
}

namespace {

struct FontSet {
  FT_Library library = nullptr;
  FT_Face faces[4] = {nullptr, nullptr, nullptr, nullptr};
  cairo_font_face_t* cairo_faces[4] = {nullptr, nullptr, nullptr, nullptr};
  std::string paths[4];
};

FontSet& fonts() {
  static FontSet set;
  return set;
}

const char* const kFontFiles[4] = {"DejaVuSans.ttf", "DejaVuSans-Bold.ttf", "DejaVuSansCondensed.ttf",
                                   "DejaVuSansCondensed-Bold.ttf"};

}  // namespace

void open_fonts(const std::string& font_dir) {
  FontSet& set = fonts();
  if (set.library != nullptr) {
    return;
  }
  if (FT_Init_FreeType(&set.library) != 0) {
    throw std::runtime_error("make_skin: cannot start FreeType");
  }
  for (int i = 0; i < 4; ++i) {
    set.paths[i] = font_dir + "/" + kFontFiles[i];
    if (FT_New_Face(set.library, set.paths[i].c_str(), 0, &set.faces[i]) != 0) {
      throw std::runtime_error("make_skin: cannot open font " + set.paths[i]);
    }
    set.cairo_faces[i] = cairo_ft_font_face_create_for_ft_face(set.faces[i], FT_LOAD_TARGET_LIGHT);
  }
}

void close_fonts() {
  FontSet& set = fonts();
  for (int i = 0; i < 4; ++i) {
    if (set.cairo_faces[i] != nullptr) {
      cairo_font_face_destroy(set.cairo_faces[i]);
    }
    set.cairo_faces[i] = nullptr;
  }
  // cairo may still cache the FreeType faces; the process ends right after, so they stay open.
}

std::string font_path(Face face) { return fonts().paths[static_cast<int>(face)]; }

void use_font(cairo_t* cr, Face face, double pixel_size) {
  cairo_set_font_face(cr, fonts().cairo_faces[static_cast<int>(face)]);
  cairo_set_font_size(cr, pixel_size);
  cairo_font_options_t* options = cairo_font_options_create();
  cairo_font_options_set_antialias(options, CAIRO_ANTIALIAS_GRAY);
  cairo_font_options_set_hint_style(options, CAIRO_HINT_STYLE_SLIGHT);
  cairo_font_options_set_hint_metrics(options, CAIRO_HINT_METRICS_ON);
  cairo_set_font_options(cr, options);
  cairo_font_options_destroy(options);
}

namespace {

std::vector<cairo_glyph_t> layout(cairo_t* cr, const std::string& text, double tracking, double* width) {
  cairo_scaled_font_t* font = cairo_get_scaled_font(cr);
  cairo_glyph_t* glyphs = nullptr;
  int count = 0;
  std::vector<cairo_glyph_t> out;
  if (cairo_scaled_font_text_to_glyphs(font, 0, 0, text.c_str(), static_cast<int>(text.size()), &glyphs, &count,
                                       nullptr, nullptr, nullptr) != CAIRO_STATUS_SUCCESS) {
    *width = 0;
    return out;
  }
  out.assign(glyphs, glyphs + count);
  cairo_glyph_free(glyphs);
  for (int i = 0; i < count; ++i) {
    out[i].x += tracking * i;
  }
  cairo_text_extents_t ext;
  cairo_scaled_font_text_extents(font, text.c_str(), &ext);
  *width = ext.x_advance + tracking * (count > 0 ? count - 1 : 0);
  return out;
}

}  // namespace

double text_width(cairo_t* cr, const std::string& text, double tracking) {
  double width = 0;
  layout(cr, text, tracking, &width);
  return width;
}

void draw_text(cairo_t* cr, const std::string& text, double x, double baseline, Align align, double tracking) {
  double width = 0;
  std::vector<cairo_glyph_t> glyphs = layout(cr, text, tracking, &width);
  double left = x;
  if (align == Align::kCentre) {
    left = x - width / 2;
  } else if (align == Align::kRight) {
    left = x - width;
  }
  // Whole-pixel starts keep small text crisp.
  left = std::floor(left + 0.5);
  baseline = std::floor(baseline + 0.5);
  for (cairo_glyph_t& g : glyphs) {
    g.x += left;
    g.y += baseline;
  }
  cairo_show_glyphs(cr, glyphs.data(), static_cast<int>(glyphs.size()));
}

double fit_font(cairo_t* cr, Face face, const std::string& text, double pixel_size, double min_size, double width,
                double tracking) {
  double size = pixel_size;
  for (;;) {
    use_font(cr, face, size);
    if (size <= min_size || text_width(cr, text, tracking) <= width) {
      return size;
    }
    size -= 0.25;
  }
}

void rounded_rect(cairo_t* cr, double x, double y, double w, double h, double r) {
  const double pi = 3.14159265358979323846;
  cairo_new_sub_path(cr);
  cairo_arc(cr, x + w - r, y + r, r, -pi / 2, 0);
  cairo_arc(cr, x + w - r, y + h - r, r, 0, pi / 2);
  cairo_arc(cr, x + r, y + h - r, r, pi / 2, pi);
  cairo_arc(cr, x + r, y + r, r, pi, 3 * pi / 2);
  cairo_close_path(cr);
}

uint32_t Noise::next() {
  state_ ^= state_ << 13;
  state_ ^= state_ >> 17;
  state_ ^= state_ << 5;
  return state_;
}

void brush_grain(Canvas& canvas, uint32_t seed, double strength) {
  Noise noise(seed);
  cairo_t* cr = canvas.cr();
  cairo_save(cr);
  cairo_set_line_width(cr, 1.0);
  for (int y = 0; y < canvas.height(); ++y) {
    double x = -noise.unit() * 40;
    while (x < canvas.width()) {
      const double len = 8 + noise.unit() * 60;
      const double v = noise.unit() * 2 - 1;
      if (v > 0) {
        cairo_set_source_rgba(cr, 1, 1, 1, v * strength);
      } else {
        cairo_set_source_rgba(cr, 0, 0, 0, -v * strength * 1.3);
      }
      cairo_move_to(cr, x, y + 0.5);
      cairo_line_to(cr, x + len, y + 0.5);
      cairo_stroke(cr);
      x += len;
    }
  }
  cairo_restore(cr);
}

}  // namespace skin
