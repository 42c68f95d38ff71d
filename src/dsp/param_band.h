#pragma once

#include "params/param_numbered.h"

// The per-band parameters; the number is the band, 0 for the lowest.

// Dynamics character: 0.5 neutral, above it squashing ("S"), below it pumping ("P").
class ParamCharacter : public plugcore::ParamNumbered {
 public:
  void get_name_prefix(char* text, int capacity) const override;
  void get_name_suffix(char* text, int capacity) const override;
  void get_unit(char* text, int capacity) const override;
  double conv_norm_to_value(float norm) const override;
  float conv_value_to_norm(double value) const override;
  void conv_value_to_text(char* text, int capacity, double value) const override;
  double conv_text_to_value(const char* text, bool& ok) const override;
};

// Strength of the dynamics stage, 0..1 as a percentage.
class ParamIntensity : public plugcore::ParamNumbered {
 public:
  void get_name_prefix(char* text, int capacity) const override;
  void get_name_suffix(char* text, int capacity) const override;
  void get_unit(char* text, int capacity) const override;
  double conv_norm_to_value(float norm) const override;
  float conv_value_to_norm(double value) const override;
  void conv_value_to_text(char* text, int capacity, double value) const override;
  double conv_text_to_value(const char* text, bool& ok) const override;
};

// Drive into the curve, 0.1..100 linear (-20..+40 dB).
class ParamDistoAmount : public plugcore::ParamNumbered {
 public:
  void get_name_prefix(char* text, int capacity) const override;
  void get_name_suffix(char* text, int capacity) const override;
  void get_unit(char* text, int capacity) const override;
  double conv_norm_to_value(float norm) const override;
  float conv_value_to_norm(double value) const override;
  void conv_value_to_text(char* text, int capacity, double value) const override;
  double conv_text_to_value(const char* text, bool& ok) const override;
};

// Distortion curve number 0..12, shown by name.
class ParamDistoType : public plugcore::ParamNumbered {
 public:
  void get_name_prefix(char* text, int capacity) const override;
  void get_name_suffix(char* text, int capacity) const override;
  void get_unit(char* text, int capacity) const override;
  int get_type() const override { return 1; }
  double conv_norm_to_value(float norm) const override;
  float conv_value_to_norm(double value) const override;
  void conv_value_to_text(char* text, int capacity, double value) const override;
  double conv_text_to_value(const char* text, bool& ok) const override;
};

// Band output gain, 0..10 linear, shown in decibels.
class ParamBandVolume : public plugcore::ParamNumbered {
 public:
  void get_name_prefix(char* text, int capacity) const override;
  void get_name_suffix(char* text, int capacity) const override;
  void get_unit(char* text, int capacity) const override;
  double conv_norm_to_value(float norm) const override;
  float conv_value_to_norm(double value) const override;
  void conv_value_to_text(char* text, int capacity, double value) const override;
  double conv_text_to_value(const char* text, bool& ok) const override;
};

// Solo switch of the band.
class ParamSolo : public plugcore::ParamNumbered {
 public:
  void get_name_prefix(char* text, int capacity) const override;
  void get_name_suffix(char* text, int capacity) const override;
  void get_unit(char* text, int capacity) const override;
  int get_type() const override { return 1; }
  double conv_norm_to_value(float norm) const override;
  float conv_value_to_norm(double value) const override;
  void conv_value_to_text(char* text, int capacity, double value) const override;
  double conv_text_to_value(const char* text, bool& ok) const override;
};
