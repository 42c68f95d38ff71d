#pragma once

// Screenshots of the X tests, kept as PNG files for people to look at.
#include <png.h>
#include <sys/stat.h>

#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <string>
#include <vector>

namespace x11_test {

// The folder the run keeps its screenshots in, made when missing; empty when
// the run asked for none (BRAKMORPH_SCREENSHOT_DIR unset), so a test run by
// hand leaves nothing in its working folder.
inline std::string screenshot_dir() {
  const char* dir = std::getenv("BRAKMORPH_SCREENSHOT_DIR");
  if (dir == nullptr || *dir == 0) return std::string();
  mkdir(dir, 0755);
  return dir;
}

// Writes 0x00RRGGBB pixels, top row first. A path in an empty folder writes nothing and succeeds.
inline bool write_png(const std::string& dir, const std::string& name, const std::vector<uint32_t>& rgb, int w,
                      int h) {
  if (dir.empty()) return true;
  FILE* f = std::fopen((dir + "/" + name).c_str(), "wb");
  if (!f) return false;
  png_structp png = png_create_write_struct(PNG_LIBPNG_VER_STRING, nullptr, nullptr, nullptr);
  png_infop info = png ? png_create_info_struct(png) : nullptr;
  if (!png || !info || setjmp(png_jmpbuf(png))) {
    png_destroy_write_struct(&png, &info);
    std::fclose(f);
    return false;
  }
  png_init_io(png, f);
  png_set_IHDR(png, info, static_cast<png_uint_32>(w), static_cast<png_uint_32>(h), 8, PNG_COLOR_TYPE_RGB,
               PNG_INTERLACE_NONE, PNG_COMPRESSION_TYPE_DEFAULT, PNG_FILTER_TYPE_DEFAULT);
  png_write_info(png, info);
  std::vector<png_byte> row(static_cast<size_t>(w) * 3);
  for (int y = 0; y < h; ++y) {
    for (int x = 0; x < w; ++x) {
      const uint32_t p = rgb[static_cast<size_t>(y) * w + x];
      row[3 * x] = static_cast<png_byte>(p >> 16);
      row[3 * x + 1] = static_cast<png_byte>(p >> 8);
      row[3 * x + 2] = static_cast<png_byte>(p);
    }
    png_write_row(png, row.data());
  }
  png_write_end(png, nullptr);
  png_destroy_write_struct(&png, &info);
  return std::fclose(f) == 0;
}

}  // namespace x11_test
