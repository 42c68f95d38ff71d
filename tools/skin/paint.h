// Drawing helpers of the skin generator: colours, an RGBA canvas on cairo, text set
// with FreeType faces, and a seeded noise source so every run paints the same pixels.
#pragma once

#include <cairo.h>

#include <cstdint>
#include <string>
#include <vector>

namespace skin {

struct Rgb {
  double r = 0, g = 0, b = 0;
};

Rgb hex(uint32_t rrggbb);
Rgb mix(const Rgb& a, const Rgb& b, double t);
Rgb scale(const Rgb& c, double f);
void set_rgb(cairo_t* cr, const Rgb& c, double alpha = 1.0);

// Straight (not premultiplied) 8-bit RGBA pixels, top row first.
struct RgbaImage {
  int width = 0;
  int height = 0;
  std::vector<uint8_t> rgba;
};

// A cairo image surface with its context; cairo keeps premultiplied pixels.
class Canvas {
 public:
  Canvas(int width, int height);
  ~Canvas();
  Canvas(const Canvas&) = delete;
  Canvas& operator=(const Canvas&) = delete;

  cairo_t* cr() const { return cr_; }
  cairo_surface_t* surface() const { return surface_; }
  int width() const { return width_; }
  int height() const { return height_; }
  RgbaImage to_rgba() const;

 private:
  int width_;
  int height_;
  cairo_surface_t* surface_;
  cairo_t* cr_;
};

enum class Face { kRegular, kBold, kCondensed, kCondensedBold };
enum class Align { kLeft, kCentre, kRight };

// Opens the DejaVu faces once; throws std::runtime_error when a font file is missing.
void open_fonts(const std::string& font_dir);
void close_fonts();
std::string font_path(Face face);

void use_font(cairo_t* cr, Face face, double pixel_size);
// Width of a text in the current font, with `tracking` pixels added between letters.
double text_width(cairo_t* cr, const std::string& text, double tracking = 0.0);
// Sets text with its baseline at y; x is the left edge, centre or right edge.
void draw_text(cairo_t* cr, const std::string& text, double x, double baseline, Align align,
               double tracking = 0.0);
// The largest size up to `pixel_size` (down to `min_size`) at which the text fits `width`.
double fit_font(cairo_t* cr, Face face, const std::string& text, double pixel_size, double min_size,
                double width, double tracking = 0.0);

void rounded_rect(cairo_t* cr, double x, double y, double w, double h, double r);

// xorshift: the same seed gives the same texture on every machine.
class Noise {
 public:
  explicit Noise(uint32_t seed) : state_(seed ? seed : 0x9e3779b9u) {}
  uint32_t next();
  double unit() { return (next() >> 8) * (1.0 / 16777216.0); }  // 0..1
 private:
  uint32_t state_;
};

// Brushed-metal grain: horizontal streaks of slightly varying brightness.
void brush_grain(Canvas& canvas, uint32_t seed, double strength);

}  // namespace skin
