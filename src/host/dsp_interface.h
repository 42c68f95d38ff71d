#pragma once

#include <string>

namespace plugcore {

class HostDspInterface;
class GuiInterface;
class NormalizedParamInterface;
class ProgramSlot;
struct PinGroup;

// The engine as the plug-in core sees it.
class DspInterface {
 public:
  virtual ~DspInterface() = default;
  virtual void init() = 0;
  virtual void set_default_state() = 0;
  virtual void close() = 0;
  virtual HostDspInterface* get_host_dsp() = 0;
  virtual void set_host_dsp(HostDspInterface* host_dsp) = 0;
  virtual GuiInterface* get_gui() = 0;
  virtual void set_gui(GuiInterface* gui) = 0;
  virtual int get_nbr_input_groups() = 0;
  virtual const PinGroup& use_input_group(int index) = 0;
  virtual int get_nbr_output_groups() = 0;
  virtual const PinGroup& use_output_group(int index) = 0;
  virtual int get_min_sample_rate() = 0;
  virtual int get_max_sample_rate() = 0;
  virtual void set_sample_rate(float rate) = 0;
  virtual void unnamed_after_sample_rate(int value) = 0;
  virtual int get_nbr_param() = 0;
  virtual NormalizedParamInterface& use_param(int index) = 0;
  virtual void set_program_name(const std::string& name) = 0;
  virtual std::string get_program_name() = 0;
  virtual void set_extra_control(int index, float norm) = 0;
  virtual double get_property_num(const char* key) = 0;
  virtual std::string get_property_str(const char* key) = 0;
  virtual void request_reset() = 0;
  virtual void set_tempo(float bpm) = 0;
  virtual void unnamed_after_tempo() = 0;
  virtual void load_program(const ProgramSlot& program) = 0;
  virtual void store_program(ProgramSlot& program) = 0;
  virtual int process_replacing(float** outputs, float** inputs, int frames, int flag) = 0;
  virtual int process_adding(float** outputs, float** inputs, int frames, int flag) = 0;
};

}  // namespace plugcore
