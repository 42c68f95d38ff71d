// The skin generator repeats itself byte for byte, the module embeds exactly what it
// writes, and it fails loudly without its fonts.
#include <gtest/gtest.h>
#include <stdlib.h>

#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <fstream>
#include <iterator>
#include <string>
#include <vector>

#include "config/resource_table.h"
#include "skin/skin_anchors.h"
#include "skin/skin_tool.h"

namespace {

std::vector<uint8_t> read_bytes(const std::string& path) {
  std::ifstream in(path, std::ios::binary);
  return std::vector<uint8_t>((std::istreambuf_iterator<char>(in)), std::istreambuf_iterator<char>());
}

std::string make_temp_dir() {
  char pattern[] = "/tmp/brakmorph_skin_XXXXXX";
  const char* dir = mkdtemp(pattern);
  return dir != nullptr ? dir : "";
}

int run_generator(const std::string& dir, const std::string& font_dir = "") {
  std::string command = std::string("\"") + BRAKMORPH_MAKE_SKIN + "\" \"" + dir + "\" \"" + dir +
                        "/skin_anchors.h\" \"" + dir + "\"";
  if (!font_dir.empty()) command += " \"" + font_dir + "\"";
  command += " 2>/dev/null";
  return std::system(command.c_str());
}

void remove_dir(const std::string& dir) {
  if (dir.size() > 5) std::system(("rm -rf \"" + dir + "\"").c_str());
}

const sys::ResourceEntry* embedded(const char* name) {
  for (int i = 0; i < brakmorph_resource_count; ++i) {
    if (std::strcmp(brakmorph_resource_table[i].type, "APIC") == 0 &&
        std::strcmp(brakmorph_resource_table[i].name, name) == 0) {
      return &brakmorph_resource_table[i];
    }
  }
  return nullptr;
}

TEST(SkinGenerator, TwoRunsGiveIdenticalFilesAndTheModuleEmbedsThem) {
  const std::string first = make_temp_dir(), second = make_temp_dir();
  ASSERT_FALSE(first.empty());
  ASSERT_FALSE(second.empty());
  ASSERT_EQ(run_generator(first), 0);
  ASSERT_EQ(run_generator(second), 0);
  std::vector<std::string> files = {"skin_anchors.h", "contact-sheet.png", "editor-background.png"};
  for (const SkinResource& r : kSkinResources) {
    files.push_back(std::string(r.name) + ".apic");
  }
  for (const std::string& file : files) {
    const std::vector<uint8_t> a = read_bytes(first + "/" + file);
    const std::vector<uint8_t> b = read_bytes(second + "/" + file);
    EXPECT_FALSE(a.empty()) << file;
    EXPECT_TRUE(a == b) << file << " differs between two runs";
  }
  for (const SkinResource& r : kSkinResources) {
    const std::vector<uint8_t> fresh = read_bytes(first + "/" + r.name + ".apic");
    const sys::ResourceEntry* entry = embedded(r.name);
    ASSERT_NE(entry, nullptr) << r.name << " is not embedded";
    EXPECT_TRUE(fresh == std::vector<uint8_t>(entry->data, entry->data + entry->size)) << r.name;
  }
  EXPECT_TRUE(read_bytes(first + "/skin_anchors.h") ==
              read_bytes(std::string(BRAKMORPH_GEN_DIR) + "/skin/skin_anchors.h"));
  // The editor preview is a PNG showing the editor twice: as it opens, and with bands 2 to 4 off.
  const std::vector<uint8_t> editor = read_bytes(first + "/editor-background.png");
  const uint8_t signature[8] = {0x89, 'P', 'N', 'G', '\r', '\n', 0x1A, '\n'};
  ASSERT_GT(editor.size(), 24u);
  EXPECT_EQ(std::memcmp(editor.data(), signature, 8), 0);
  auto be32 = [&](size_t at) {
    return (editor[at] << 24) | (editor[at + 1] << 16) | (editor[at + 2] << 8) | editor[at + 3];
  };
  EXPECT_EQ(be32(16), 609);
  EXPECT_GE(be32(20), 2 * 282);
  remove_dir(first);
  remove_dir(second);
}

TEST(SkinGenerator, MissingFontsFailWithoutWritingAnything) {
  const std::string dir = make_temp_dir();
  ASSERT_FALSE(dir.empty());
  EXPECT_NE(run_generator(dir, dir + "/no-fonts-here"), 0);
  EXPECT_TRUE(read_bytes(dir + "/skin_anchors.h").empty());
  EXPECT_TRUE(read_bytes(dir + "/bkg_24_master.apic").empty());
  remove_dir(dir);
}

}  // namespace
