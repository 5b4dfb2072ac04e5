#pragma once

#include <string>
#include <string_view>

#include <velkui/controls/ControlState.h>
#include <velkui/controls/ListenerList.h>
#include <velkui/pictel/Pictel.h>
#include <velkui/pictel/PictelHandles.h>
#include <velkui/ui/NodeTypes.h>

namespace velkui::controls {

class UI_ControlView;

// Where a picture-showing control gets its image: from an image supply
// function (sent a UI_PictureSupplyMessage, it answers with SetImage), or
// from the library's images by base name. Names follow one scheme: "<base>"
// is the picture at rest, "<base>_D" the picture while down or on; on dark
// interfaces "KT7_<base>" and "KT7_<base>_D" are preferred where they exist.
class ButtonImageSource {
 public:
  const std::string& GetBaseName() const { return baseName_; }
  void SetBaseName(std::string name) { baseName_ = std::move(name); }
  const ConstControlCallbackP& GetSupplyFunction() const { return supply_; }
  void SetSupplyFunction(const ConstControlCallbackP& supply) { supply_ = supply; }
  bool IsEmpty() const { return baseName_.empty() && !(supply_ && *supply_); }

  // The image for the control in `state`. `baseName` replaces the stored base
  // name when not empty; `on` selects the "_D" picture. Null when there is none.
  pictel::ImageP GetImage(const UI_ControlView& control, const pictel::Pictel& context,
                          ControlState state, ui::ModifierKeys modKeys, bool on,
                          std::string_view baseName = {}) const;

 private:
  std::string baseName_;
  ConstControlCallbackP supply_;
};

}  // namespace velkui::controls
