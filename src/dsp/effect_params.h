#pragma once

// The forty parameters of the effect, by family.
#include "dsp/param_band.h"
#include "dsp/param_feedback.h"
#include "dsp/param_flags.h"
#include "dsp/param_master_vol.h"
#include "dsp/param_split_freq.h"
#include "dsp/param_stereo_amount.h"
#include "dsp/param_tone.h"
