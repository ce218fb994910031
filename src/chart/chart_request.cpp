#include "chart/chart_request.h"

namespace kora {

ChartRequest RequestFromSettings(const Settings& settings) {
  const ChartSettings& c = settings.charts;
  ChartRequest request;
  request.ChartStyle = ParseStyle(c.Type).value_or(request.ChartStyle);
  request.ChartPeriod = ParsePeriod(c.Period).value_or(request.ChartPeriod);
  request.BarSpacing = c.Spacing;
  request.BlankSpace = c.BlankSpace;
  request.WeekFactor = c.WeekFactor;
  request.VolHeight = c.VolHeight;
  request.CutVols = settings.osc.CutVols;
  request.AutoScale = c.ScMethod;
  request.LogBars = settings.osc.BCCalTp;
  request.LogLines = settings.osc.LCalTp;
  request.LogVolume = settings.osc.VCalTp;
  request.GridLines = c.GridLines;
  request.HalfGrid = c.HalfGrid;
  request.MovingGrid = c.MovingGrid;
  request.GridSpace = c.GridSpace;
  request.Legible = c.Legible;
  request.Ma1On = c.AvOne;
  request.Ma2On = c.AvTwo;
  request.MaExp = c.AvCalc;
  request.Ma1Days = c.Av1D;
  request.Ma2Days = c.Av2D;
  request.Ma1Weeks = c.Av1W;
  request.Ma2Weeks = c.Av2W;
  request.BandKind = c.Bands;
  request.StopLossShown = c.StopLoss;
  request.StopLossPct = c.StopLossPct;
  request.ScriptPrintMode = settings.words.ScriptPrintMode;
  return request;
}

}  // namespace kora
