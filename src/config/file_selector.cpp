#include "config/file_selector.h"

#include "config/system_ui.h"

namespace sys {

namespace {
size_t last_separator(const std::string& path) { return path.find_last_of("/\\"); }
}  // namespace

FileSelector::FileSelector() : filters_{{"All files", "*.*"}} {}

void FileSelector::set_filters(const std::vector<FileFilter>& filters) {
  filters_ = filters;
  filter_index_ = 0;
}

std::string FileSelector::directory_part(const std::string& path) {
  const size_t sep = last_separator(path);
  return sep == std::string::npos ? std::string() : path.substr(0, sep);
}

std::string FileSelector::name_part(const std::string& path) {
  const size_t sep = last_separator(path);
  return sep == std::string::npos ? path : path.substr(sep + 1);
}

std::string FileSelector::pattern_extension(const std::string& pattern) {
  // Only the first of several patterns ("*.a;*.b") names the extension.
  std::string first = pattern.substr(0, pattern.find_first_of(",;"));
  if (first.empty() || first[0] != '*') {
    return std::string();
  }
  first.erase(0, 1);
  // "*.*" and "*" stand for no extension in particular.
  if (first.empty() || first.find('*') != std::string::npos || first.find('?') != std::string::npos) {
    return std::string();
  }
  return first;
}

int32_t FileSelector::run(bool save) {
  FileDialogRequest request;
  request.save = save;
  request.title = title_;
  request.directory = directory_part(path_);
  request.file_name = name_part(path_);
  request.filters = filters_;
  request.filter_index = filter_index_;
  const FileDialogResult result = use_system_ui().run_file_dialog(request);
  if (result.status != kChosen) {
    return result.status == kCancelled ? kCancelled : kFailed;
  }
  if (result.path.empty()) {
    return kFailed;
  }
  if (result.filter_index >= 0 && result.filter_index < static_cast<int32_t>(filters_.size())) {
    filter_index_ = result.filter_index;
  }
  path_ = result.path;
  // A name typed without extension gets the selected type's.
  if (name_part(path_).find('.') == std::string::npos && filter_index_ < static_cast<int32_t>(filters_.size())) {
    path_ += pattern_extension(filters_[filter_index_].pattern);
  }
  return kChosen;
}

}  // namespace sys
