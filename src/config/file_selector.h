#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "config/system_ui_interface.h"

namespace sys {

// The open/save file dialog with its remembered path, type filters and title.
class FileSelector {
 public:
  enum Result : int32_t { kChosen = 0, kCancelled = 1, kFailed = -1024 };

  FileSelector();

  void set_path(const std::string& path) { path_ = path; }
  const std::string& get_path() const { return path_; }
  void set_filters(const std::vector<FileFilter>& filters);
  const std::vector<FileFilter>& get_filters() const { return filters_; }
  void set_filter_index(int32_t index) { filter_index_ = index; }
  int32_t get_filter_index() const { return filter_index_; }
  void set_title(const std::string& title) { title_ = title; }
  const std::string& get_title() const { return title_; }

  // 0 (the path now holds the chosen file), 1 (cancelled) or -1024; the path is
  // unchanged unless a file was chosen.
  int32_t run_open() { return run(false); }
  int32_t run_save() { return run(true); }

  // Splits a path at its last separator ('/' or '\\').
  static std::string directory_part(const std::string& path);
  static std::string name_part(const std::string& path);
  // The extension a filter pattern stands for: the text after its leading '*' (".pbk").
  static std::string pattern_extension(const std::string& pattern);

 private:
  int32_t run(bool save);

  std::string path_;
  std::vector<FileFilter> filters_;
  int32_t filter_index_ = 0;
  std::string title_;
};

}  // namespace sys
