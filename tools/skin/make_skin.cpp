// Build tool: draws the editor's skin and writes it as "APIC" resources.
//   make_skin RESOURCE_DIR HEADER PREVIEW_DIR [FONT_DIR]
// RESOURCE_DIR receives one NAME.apic per resource, HEADER the picture anchors for
// the editor, PREVIEW_DIR contact-sheet.png and editor-background.png.
#include <unistd.h>

#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <exception>
#include <fstream>
#include <set>
#include <string>
#include <vector>

#include "anchors_header.h"
#include "pictures.h"
#include "previews.h"

namespace {

void write_file(const std::string& path, const void* data, size_t size) {
  const std::string temp = path + ".tmp";
  std::ofstream out(temp, std::ios::binary | std::ios::trunc);
  out.write(static_cast<const char*>(data), static_cast<std::streamsize>(size));
  out.close();
  if (!out || std::rename(temp.c_str(), path.c_str()) != 0) {
    throw std::runtime_error("make_skin: cannot write " + path);
  }
}

}  // namespace

int main(int argc, char** argv) {
  if (argc < 4 || argc > 5) {
    std::fprintf(stderr, "usage: make_skin RESOURCE_DIR HEADER PREVIEW_DIR [FONT_DIR]\n");
    return 2;
  }
  // The quantiser may spread work over threads, which can change its sums; one
  // thread keeps the output identical from run to run. The thread count is read
  // when the runtime loads, so the tool restarts itself once with it set.
  const char* threads = std::getenv("OMP_NUM_THREADS");
  if (threads == nullptr || std::strcmp(threads, "1") != 0) {
    setenv("OMP_NUM_THREADS", "1", 1);
    execv("/proc/self/exe", argv);
    std::fprintf(stderr, "make_skin: cannot restart single-threaded\n");
    return 1;
  }
  const std::string resource_dir = argv[1];
  const std::string header_path = argv[2];
  const std::string preview_dir = argv[3];
  const std::string font_dir = argc == 5 ? argv[4] : "/usr/share/fonts/truetype/dejavu";
  try {
    skin::open_fonts(font_dir);
    std::vector<skin::Picture> pictures;
    skin::add_backgrounds(pictures);
    skin::add_control_pictures(pictures);
    skin::add_fonts(pictures);
    skin::EncodedSet encoded;
    std::set<std::string> names;
    for (const skin::Picture& p : pictures) {
      if (!names.insert(p.name).second) {
        throw std::runtime_error("make_skin: two pictures named " + p.name);
      }
      std::vector<uint8_t> bytes = p.kind == skin::kApicUnicolorFont
                                       ? skin::encode_coverage(p.image.width, p.image.height, p.coverage, p.flag)
                                       : skin::encode_indexed(p.image, p.kind, p.flag);
      write_file(resource_dir + "/" + p.name + ".apic", bytes.data(), bytes.size());
      encoded[p.name] = std::move(bytes);
    }
    const std::string header = skin::anchors_header(pictures);
    write_file(header_path, header.data(), header.size());
    skin::write_contact_sheet(pictures, encoded, preview_dir + "/contact-sheet.png");
    skin::write_editor_preview(encoded, preview_dir + "/editor-background.png");
    skin::close_fonts();
  } catch (const std::exception& e) {
    std::fprintf(stderr, "%s\n", e.what());
    return 1;
  }
  return 0;
}
