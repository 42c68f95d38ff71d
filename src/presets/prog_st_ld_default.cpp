#include "presets/prog_st_ld_default.h"

#include <cstring>

#include "host/dsp_interface.h"
#include "params/normalized_param_interface.h"
#include "presets/program_slot.h"

namespace plugcore {

void ProgStLdDefault::mix(ProgramSlot& out, const ProgramSlot& from, const ProgramSlot& to, double position) {
  const int n = to.get_nbr_values();
  const int nbr_from = from.get_nbr_values();
  const int nbr_param = dsp_ != nullptr ? dsp_->get_nbr_param() : 0;
  out.set_nbr_values(n);
  for (int i = 0; i < n; ++i) {
    const double b = to.get_value(i);
    // A shorter from program has nothing to glide from: its missing values start at the target.
    const double a = i < nbr_from ? from.get_value(i) : b;
    const bool stepped = i < nbr_param && dsp_->use_param(i).get_type() != 0;
    out.set_value(i, stepped ? static_cast<float>(b) : static_cast<float>((b - a) * position + a));
  }
  out.set_extra_size(to.get_extra_size());
  if (to.get_extra_size() > 0) {
    std::memcpy(out.use_extra_data(), to.use_extra_data(), static_cast<size_t>(to.get_extra_size()));
  }
}

}  // namespace plugcore
