// Pictures for people: a contact sheet of every resource with its name, and the
// editor composed from the backgrounds with the controls drawn at their places.
// Both are drawn from the encoded resources, so they show what the module embeds.
#pragma once

#include <cstdint>
#include <map>
#include <string>
#include <vector>

#include "pictures.h"

namespace skin {

using EncodedSet = std::map<std::string, std::vector<uint8_t>>;

void write_contact_sheet(const std::vector<Picture>& pictures, const EncodedSet& encoded, const std::string& path);
void write_editor_preview(const EncodedSet& encoded, const std::string& path);

}  // namespace skin
