#pragma once

#include <boost/intrusive_ptr.hpp>

#include <velkui/controls/UI_Checkbox.h>
#include <velkui/controls/UI_RadioGroup.h>
#include <velkui/controls/UI_TextButton.h>
#include <velkui/ui/UI_Dialog.h>

namespace gallery {

// A dialog as a host would write one: a heading, a wrapped message, a choice
// of formats, two options and the Cancel and Export buttons (Export is the
// OK button, so Return presses it), placed by the control layouts and the
// layout decorators. The content size follows the layout. It remembers its
// place under the node ID "GalleryExportDialog".
class ExportDialog : public velkui::ui::UI_Dialog {
 public:
  explicit ExportDialog(velkui::ui::OS_Window* owner);

  const boost::intrusive_ptr<velkui::controls::UI_TextButton>& ExportButton() const {
    return export_;
  }
  const boost::intrusive_ptr<velkui::controls::UI_TextButton>& CancelButton() const {
    return cancel_;
  }
  const boost::intrusive_ptr<velkui::controls::UI_RadioGroup>& Formats() const { return formats_; }

 private:
  void BuildContent();

  boost::intrusive_ptr<velkui::controls::UI_TextButton> export_;
  boost::intrusive_ptr<velkui::controls::UI_TextButton> cancel_;
  boost::intrusive_ptr<velkui::controls::UI_RadioGroup> formats_;
};

using ExportDialogP = boost::intrusive_ptr<ExportDialog>;

}  // namespace gallery
