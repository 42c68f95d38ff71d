#pragma once

#include <string>

// Text helpers shared by the effect's parameters. A display text is formed
// in full, cut to the parameter's width, then copied with the caller's
// capacity; reading uses the C library scan.

// printf-style formatting into a string of any length.
std::string format_param_text(const char* format, double value);
std::string format_param_int(const char* format, int value);

// Cuts `full` to at most `width` characters, then copies it bounded.
void write_param_text(char* text, int capacity, const std::string& full, int width);

// Case-insensitive substring test; a null text contains nothing.
bool param_text_contains(const char* text, const char* word);

// One "%lf"-style field read with `format`; true when one field converted.
bool read_param_double(const char* text, const char* format, double& value);

double clamp_param(double value, double low, double high);

// Shared forms.
void write_frequency_text(char* text, int capacity, double hz);       // 5000, 256.0, 20.00
void write_percent_text(char* text, int capacity, double fraction);   // 0.0 .. 100.0
void write_gain_db_text(char* text, int capacity, double gain);       // -oo, 0.0, -12.0
void write_switch_text(char* text, int capacity, bool on);            // On / Off
// "on" / "off" / a number (>= 0.5 is on); sets ok when one of them applied.
double read_switch_text(const char* text, bool& ok);
