#include "chart/chart_state.h"

namespace kora {

ChartRequest MakeRequest(ChartState& state, const Settings& settings, const NameRec& name) {
  if (name.RecType <= kAdvanceDecline && NeedsRange(state.ChartStyle))
    state.ChartStyle = Style::kLine;
  ChartRequest request = RequestFromSettings(settings);
  request.Name = name;
  request.ChartStyle = state.ChartStyle;
  request.ChartPeriod = state.ChartPeriod;
  request.BarSpacing = state.BarSpacing;
  request.BandKind = state.BandKind;
  request.Ma1On = state.Ma1On;
  request.Ma2On = state.Ma2On;
  request.VolumeOption = state.VolumeOption;
  request.FinishDateOn = state.DateLimitOn;
  request.FinishDate = state.DateLimitDate;
  request.ColourMarks = state.ReversalsOn;
  request.OutsideMarks = state.OutsideDaysOn;
  request.PFAutoBox = state.PFAutoBox;
  request.PFBoxSize = state.PFBoxSize;
  if (state.SwingOn) {
    request.Swing = state.Swing.kind;
    request.SwingSize = state.Swing.size;
  }
  request.OscName = state.OscCode;
  request.SuppressScript = state.SuppressScript;
  return request;
}

}  // namespace kora
