#pragma once

#include "params/normalized_param_interface.h"

namespace plugcore {

// A parameter that belongs to a numbered unit (a band, a split point); its name
// is prefix, number + 1, suffix ("B3 Dist Type").
class ParamNumbered : public virtual NormalizedParamInterface {
 public:
  using NormalizedParamInterface::init;
  virtual void init(double default_value, int priority, int number);
  virtual int get_number() const { return number_; }
  virtual void get_name_prefix(char* text, int capacity) const = 0;
  virtual void get_name_suffix(char* text, int capacity) const = 0;

  void get_name(char* text, int capacity) const override;

 protected:
  int number_ = -1;
};

}  // namespace plugcore
