#include "chart/chart_state.h"

namespace kora {

ChartRequest MakeRequest(ChartState& state, const Settings& settings, const NameRec& name) {
  if (name.RecType <= kAdvanceDecline && (state.ChartStyle == 'B' || state.ChartStyle == 'C'))
    state.ChartStyle = 'L';
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
  request.OscName = state.OscCode;
  request.MultiOscOn = state.MultiOscOn;
  request.SuppressScript = state.SuppressScript;
  return request;
}

}  // namespace kora
