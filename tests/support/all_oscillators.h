#pragma once

// Every oscillator's routine and periods.

#include "indicators/coppock.h"
#include "indicators/directional_movement.h"
#include "indicators/elder_ray.h"
#include "indicators/holy_grail.h"
#include "indicators/macd.h"
#include "indicators/obv.h"
#include "indicators/oscillators.h"
#include "indicators/parabolic.h"
#include "indicators/rmo.h"
#include "indicators/rmx.h"
#include "indicators/roc_momentum.h"
#include "indicators/rsi.h"
#include "indicators/stochastic_fx.h"
#include "indicators/volatility.h"
#include "indicators/williams.h"
