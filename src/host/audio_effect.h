#pragma once

#include <cstdint>

#include "host/vst2_abi.h"

class AEffEditor;

// Glue between the plain effect record a host calls and a C++ object: the record's
// function entries forward to the virtual operations below.
class AudioEffect {
 public:
  AudioEffect(Vst2HostCallback host, int32_t num_programs, int32_t num_params);
  AudioEffect(const AudioEffect&) = delete;
  AudioEffect& operator=(const AudioEffect&) = delete;
  virtual ~AudioEffect();

  AEffect* getAeffect() { return &effect_; }
  void setEditor(AEffEditor* editor);
  AEffEditor* getEditor() const { return editor_; }

  virtual intptr_t dispatcher(int32_t opcode, int32_t index, intptr_t value, void* ptr, float opt);
  virtual void open() {}
  virtual void close() {}
  virtual void suspend() {}
  virtual void resume() {}
  virtual void setProgram(int32_t program) { cur_program_ = program; }
  virtual void setProgramName(const char* name) {}
  virtual void getProgramName(char* name) { name[0] = 0; }
  virtual int32_t getProgram() { return cur_program_; }
  virtual void getParameterLabel(int32_t index, char* label) { label[0] = 0; }
  virtual void getParameterDisplay(int32_t index, char* text) { text[0] = 0; }
  virtual void getParameterName(int32_t index, char* text) { text[0] = 0; }
  virtual void setSampleRate(float rate) { sample_rate_ = rate; }
  virtual void setBlockSize(int32_t size) { block_size_ = size; }
  virtual int32_t getChunk(void** data, bool is_preset) { return 0; }
  virtual int32_t setChunk(void* data, int32_t size, bool is_preset) { return 0; }
  virtual void setParameter(int32_t index, float value) {}
  virtual float getParameter(int32_t index) { return 0.0f; }
  virtual void process(float** inputs, float** outputs, int32_t frames) {}
  virtual void processReplacing(float** inputs, float** outputs, int32_t frames) {}

  // Host callback wrappers; each answers 0 when there is no callback.
  intptr_t call_host(int32_t opcode, int32_t index = 0, intptr_t value = 0, void* ptr = nullptr,
                     float opt = 0.0f) const;
  bool has_host() const { return host_ != nullptr; }
  virtual void setParameterAutomated(int32_t index, float value);
  virtual bool isInputConnected(int32_t pin);
  virtual bool isOutputConnected(int32_t pin);

  void setUniqueID(int32_t id) { effect_.uniqueID = id; }
  void setNumInputs(int32_t n) { effect_.numInputs = n; }
  void setNumOutputs(int32_t n) { effect_.numOutputs = n; }
  void set_flag(int32_t flag, bool on);
  float getSampleRate() const { return sample_rate_; }
  int32_t getBlockSize() const { return block_size_; }
  int32_t getNumPrograms() const { return num_programs_; }
  int32_t getNumParams() const { return num_params_; }

 protected:
  float sample_rate_ = 44100.0f;
  AEffEditor* editor_ = nullptr;
  Vst2HostCallback host_;
  int32_t num_programs_;
  int32_t num_params_;
  int32_t cur_program_ = 0;
  int32_t block_size_ = 1024;
  AEffect effect_;
};
