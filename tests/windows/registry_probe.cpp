// Drives the per-user value store from the command line, so a script can check
// it against the real registry under Windows or Wine:
//   registry_probe set PATH NAME TEXT     store a text value
//   registry_probe get PATH NAME          print the stored text
//   registry_probe switch PATH NAME N     print the 0/1 switch, falling back to N
#include <cstdio>
#include <cstdlib>
#include <exception>
#include <string>

#include "config/persistent_key_list.h"

int main(int argc, char** argv) {
  if (argc < 4) {
    std::fprintf(stderr, "usage: registry_probe set|get|switch PATH NAME [TEXT|FALLBACK]\n");
    return 2;
  }
  const std::string command = argv[1];
  const std::string path = argv[2];
  const std::string name = argv[3];
  try {
    if (command == "set" && argc == 5) {
      sys::PersistentKeyList key(path, true);
      return key.set_string(name, argv[4]) == 0 ? 0 : 1;
    }
    if (command == "get") {
      sys::PersistentKeyList key(path, false);
      std::string text;
      if (key.get_string(name, text) != 0) {
        std::fprintf(stderr, "registry_probe: no value %s\n", name.c_str());
        return 1;
      }
      std::printf("%s\n", text.c_str());
      return 0;
    }
    if (command == "switch" && argc == 5) {
      std::printf("%d\n", sys::read_persistent_switch(path, name, std::atoi(argv[4])));
      return 0;
    }
  } catch (const std::exception& error) {
    std::fprintf(stderr, "registry_probe: %s\n", error.what());
    return 1;
  }
  std::fprintf(stderr, "registry_probe: bad command\n");
  return 2;
}
