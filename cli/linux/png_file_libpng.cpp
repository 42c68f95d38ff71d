// PNG reading and writing with libpng's simplified interface.
#include <png.h>

#include <stdexcept>
#include <vector>

#include "cli/png_file.h"

namespace plugcore {

void write_png(const std::string& path, const PixelImage& image) {
  png_image png{};
  png.version = PNG_IMAGE_VERSION;
  png.width = static_cast<png_uint_32>(image.width);
  png.height = static_cast<png_uint_32>(image.height);
  png.format = PNG_FORMAT_RGB;
  std::vector<unsigned char> rgb(static_cast<size_t>(image.width) * image.height * 3);
  for (size_t i = 0; i < image.pixels.size(); ++i) {
    rgb[3 * i] = static_cast<unsigned char>(image.pixels[i] >> 16);
    rgb[3 * i + 1] = static_cast<unsigned char>(image.pixels[i] >> 8);
    rgb[3 * i + 2] = static_cast<unsigned char>(image.pixels[i]);
  }
  if (png_image_write_to_file(&png, path.c_str(), 0, rgb.data(), 0, nullptr) == 0) {
    const std::string reason = png.message;
    png_image_free(&png);
    throw std::runtime_error("cannot write " + path + ": " + reason);
  }
}

PixelImage read_png(const std::string& path) {
  png_image png{};
  png.version = PNG_IMAGE_VERSION;
  if (png_image_begin_read_from_file(&png, path.c_str()) == 0) {
    throw std::runtime_error("cannot read " + path + ": " + png.message);
  }
  png.format = PNG_FORMAT_RGB;
  std::vector<unsigned char> rgb(PNG_IMAGE_SIZE(png));
  if (png_image_finish_read(&png, nullptr, rgb.data(), 0, nullptr) == 0) {
    const std::string reason = png.message;
    png_image_free(&png);
    throw std::runtime_error("cannot read " + path + ": " + reason);
  }
  PixelImage image;
  image.width = static_cast<int>(png.width);
  image.height = static_cast<int>(png.height);
  image.pixels.resize(static_cast<size_t>(image.width) * image.height);
  for (size_t i = 0; i < image.pixels.size(); ++i) {
    image.pixels[i] = static_cast<uint32_t>(rgb[3 * i]) << 16 | static_cast<uint32_t>(rgb[3 * i + 1]) << 8 |
                      rgb[3 * i + 2];
  }
  return image;
}

}  // namespace plugcore
