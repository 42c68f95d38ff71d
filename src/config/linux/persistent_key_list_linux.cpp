// Per-user values as setting files: the path "A/B" is the file
// $XDG_CONFIG_HOME/A/B.cfg.txt, one data key per value in the configuration
// text format, replaced as a whole on every write.
#include <sys/stat.h>
#include <unistd.h>

#include <atomic>
#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <memory>
#include <sstream>
#include <stdexcept>
#include <vector>

#include "config/conf_key_factory.h"
#include "config/persistent_key_list.h"
#include "presets/replace_file.h"

namespace sys {

struct PersistentKeyList::Handles {
  std::string file;
  std::string root_name;
};

namespace {

const char kOpenError[] = "sys::PersistentKeyList::PersistentKeyList () : Cannot open path.";
const char kCreateError[] = "sys::PersistentKeyList::PersistentKeyList () : Cannot create path.";

std::string config_home() {
  const char* xdg = std::getenv("XDG_CONFIG_HOME");
  if (xdg != nullptr && xdg[0] == '/') {
    return xdg;
  }
  const char* home = std::getenv("HOME");
  if (home == nullptr || home[0] != '/') {
    throw std::runtime_error(kOpenError);
  }
  return std::string(home) + "/.config";
}

bool is_directory(const std::string& path) {
  struct stat info;
  return ::stat(path.c_str(), &info) == 0 && S_ISDIR(info.st_mode);
}

void open_directory(const std::string& path, bool create) {
  if (is_directory(path)) {
    return;
  }
  if (!create) {
    throw std::runtime_error(kOpenError);
  }
  if (::mkdir(path.c_str(), 0700) != 0 && !(errno == EEXIST && is_directory(path))) {
    throw std::runtime_error(kCreateError);
  }
}

std::unique_ptr<basic::ConfKeyMulti> read_values(const PersistentKeyList::Handles& handles) {
  std::ifstream in(handles.file);
  std::unique_ptr<basic::ConfKeyMulti> root;
  if (in) {
    std::stringstream text;
    text << in.rdbuf();
    basic::ConfKeyFactory factory;
    std::unique_ptr<basic::ConfKeyInterface> key = factory.create_from_string(text.str());
    auto* multi = dynamic_cast<basic::ConfKeyMulti*>(key.get());
    if (factory.get_status() == 0 && multi != nullptr) {
      key.release();
      root.reset(multi);
    }
  }
  if (!root) {
    root = std::make_unique<basic::ConfKeyMulti>(handles.root_name);  // missing or damaged: start afresh
  }
  return root;
}

}  // namespace

PersistentKeyList::PersistentKeyList(const std::string& path, bool create) : handles_(new Handles) {
  std::vector<std::string> parts;
  std::stringstream stream(path);
  std::string part;
  while (std::getline(stream, part, '/')) {
    if (part.empty() || part == "." || part == ".." || part.find('\\') != std::string::npos) {
      throw std::runtime_error(kOpenError);
    }
    parts.push_back(part);
  }
  if (parts.empty()) {
    throw std::runtime_error(kOpenError);
  }
  std::string directory = config_home();
  open_directory(directory, create);
  for (size_t i = 0; i + 1 < parts.size(); ++i) {
    directory += "/" + parts[i];
    open_directory(directory, create);
  }
  handles_->file = directory + "/" + parts.back() + ".cfg.txt";
  handles_->root_name = basic::ConfKeyInterface::make_valid_name(parts.back());
}

PersistentKeyList::~PersistentKeyList() = default;

int PersistentKeyList::get_string(const std::string& name, std::string& text) {
  text.clear();
  try {
    const auto root = read_values(*handles_);
    const auto* data = dynamic_cast<const basic::ConfKeyData*>(root->find_key(name));
    const auto* value = data != nullptr ? dynamic_cast<const basic::ConfKeyContentString*>(&data->use_content())
                                        : nullptr;
    if (value == nullptr) {
      return -1;
    }
    text = value->get_string().substr(0, kValueCapacity - 1);
    return 0;
  } catch (const std::exception&) {
    return -1;  // a name that is no valid key name cannot be stored either
  }
}

int PersistentKeyList::set_string(const std::string& name, const std::string& text) {
  // The text format has no escapes: a quote or a line break would not read back.
  if (name.empty() || text.find_first_of("\"\n\r") != std::string::npos || name.find_first_of("\"\n\r") != std::string::npos) {
    return -1;
  }
  try {
    auto root = read_values(*handles_);
    root->set_key(basic::ConfKeyData(name, text));
    std::string out;
    if (root->write_to_string(out, 0) != 0) {
      return -1;
    }
    out += '\n';
    static std::atomic<unsigned> serial{0};  // threads of one process need their own temporary too
    const std::string temp =
        handles_->file + ".part" + std::to_string(::getpid()) + "_" + std::to_string(serial.fetch_add(1));
    std::FILE* file = std::fopen(temp.c_str(), "w");
    if (file == nullptr) {
      return -1;
    }
    const bool written = std::fwrite(out.data(), 1, out.size(), file) == out.size();
    const bool closed = std::fclose(file) == 0;
    if (!written || !closed || !plugcore::replace_file(temp, handles_->file)) {
      std::remove(temp.c_str());
      return -1;
    }
    return 0;
  } catch (const std::exception&) {
    return -1;
  }
}

}  // namespace sys
