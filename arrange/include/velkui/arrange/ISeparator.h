#pragma once

#include <velkui/arrange/ArrangeTypes.h>

namespace velkui::arrange {

// Something a group draws in the gap between two consecutive children. The group never owns
// its separators: the host that built them destroys them in its ClearSeparators.
class ISeparator {
 public:
  // acrossColumn is false between two children of a row, true between two children of a column.
  virtual void SetSeparatorFrame(bool acrossColumn, const RectF& frame) = 0;
  virtual ~ISeparator() = default;
};

}  // namespace velkui::arrange
