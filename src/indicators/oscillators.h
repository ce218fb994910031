#pragma once

#include "indicators/osc_panel.h"

namespace kora {

// The panels. Each header of its own name tells the formula. A period of 0 draws and writes
// nothing.
void ShowStochasticFX(OscHost& host);
void ShowROC(OscHost& host);
void ShowMomentum(OscHost& host);
void ShowWilliams(OscHost& host);
void ShowRMO(OscHost& host);
void ShowRMX(OscHost& host);
void ShowRSI(OscHost& host);
void ShowVolatility(OscHost& host);
void ShowMACD(OscHost& host);
void ShowDirectionalMovement(OscHost& host);
void ShowElderRay(OscHost& host);
void ShowCoppock(OscHost& host);
void ShowHolyGrail(OscHost& host);
void ShowOBV(OscHost& host);

// Overlays of the price chart; they have no panel.
void ShowParabolic(OscHost& host);
void ShowParabolicOnAverage(OscHost& host);

// True for the codes that have a panel of their own ("PARA" and "PARAV" have none).
bool HasPanel(std::string_view oscCode);

// Draws the oscillator of host.OscCode. "R/F" is ROC with FX as a second pass over its panel.
// A code that names no oscillator draws nothing.
void ShowOscillatorPanel(OscHost& host);

}  // namespace kora
