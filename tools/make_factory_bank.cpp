// Build tool: writes the factory bank file that the module carries as its
// bank resources. Usage: make_factory_bank OUT.pbk
#include <cstdio>

#include "presets/bank_file.h"
#include "presets/bank_manager.h"
#include "presets/bank_status.h"
#include "presets/factory_programs.h"

int main(int argc, char** argv) {
  if (argc != 2) {
    std::fprintf(stderr, "usage: make_factory_bank OUT.pbk\n");
    return 2;
  }
  plugcore::BankManager bank;
  plugcore::make_factory_bank(bank);
  const int status = plugcore::save_bank_file(argv[1], bank);
  if (status != plugcore::kBankOk) {
    std::fprintf(stderr, "make_factory_bank: %s: %s (code %d)\n", argv[1], plugcore::describe_bank_status(status),
                 status);
    return 1;
  }
  return 0;
}
