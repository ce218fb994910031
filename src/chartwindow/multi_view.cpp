#include "chartwindow/multi_view.h"

#include <algorithm>
#include <cmath>

#include "indicators/price_overlays.h"

namespace kora {
namespace {

constexpr double kLeastPanel = 80;  // chart units

}  // namespace

MultiView::MultiView(const MultiViewServices& services, int set) : services_(services), set_(set) {}

std::string MultiView::Caption() const {
  return MultiOscCaption(FromAnsi(services_.current.Rec.Code.trimmed()), set_);
}

std::string MultiView::SwapCaption() const {
  return "Show &Multi-Oscillator " + std::to_string(3 - set_);
}

std::string MultiView::ScriptPath() const {
  return services_.settings.paths.CurrentDataPath + "TCht.Tmp";
}

bool MultiView::Draw(Surface& price, std::span<Surface* const> panels) {
  ChartState& state = services_.state;
  state.SuppressScript = false;
  Request = MakeRequest(state, services_.settings, services_.current.Rec);
  // Each panel says what it is; none changes the prices.
  Request.OscName.clear();
  Chart = {};
  ChartScript script(services_.files, ScriptPath());
  return DrawMultiOsc({.files = services_.files,
                       .dialogs = services_.dialogs,
                       .paths = services_.settings.paths,
                       .fonts = services_.settings.fonts,
                       .colours = services_.colours,
                       .price = price,
                       .script = &script,
                       .overlays = PriceOverlays(state.MMAOn, services_.settings.osc.MMASet),
                       .VolumeUnitText = services_.VolumeUnitText},
                      services_.settings, Request, Chart, Names(), panels);
}

MultiPage LayOutMultiPage(double width, double height, int panels) {
  MultiPage page;
  page.width = std::max(std::floor(width), 1.0);
  const double form = std::max(std::floor(height / 2), panels * kLeastPanel);
  page.price = std::max(form, 1.0);
  page.panel = MultiOscPanelHeight(page.price, std::max(panels, 1));
  return page;
}

}  // namespace kora
