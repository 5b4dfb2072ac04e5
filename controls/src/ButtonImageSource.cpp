#include <velkui/controls/ButtonImageSource.h>

#include <velkui/controls/UI_ControlView.h>

#include "ControlDrawing.h"

namespace velkui::controls {

pictel::ImageP ButtonImageSource::GetImage(const UI_ControlView& control,
                                           const pictel::Pictel& context, ControlState state,
                                           ui::ModifierKeys modKeys, bool on,
                                           std::string_view baseName) const {
  if (supply_ && *supply_) {
    UI_PictureSupplyMessage message(&control, state, modKeys);
    UI_ControlView::SendControlMessage(supply_, &message);
    if (message.GetImage() == nullptr) return {};
    return pictel::ImageP(boost::intrusive_ptr<pictel::ImageInterface>(message.GetImage()));
  }
  const std::string base(baseName.empty() ? std::string_view(baseName_) : baseName);
  if (base.empty()) return {};
  if (on) {
    if (pictel::ImageP image = detail::FindControlImage(context, base + "_D")) return image;
  }
  return detail::FindControlImage(context, base);
}

}  // namespace velkui::controls
