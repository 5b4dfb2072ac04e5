#pragma once

#include <boost/intrusive_ptr.hpp>

#include <velkcore/Geometry.h>
#include <velkui/ui/UI_Node.h>

namespace gallery {

// Shows `node` at `frame` (parent coordinates) as the last child of `parent`.
template <typename Node>
boost::intrusive_ptr<Node> Place(velkui::ui::UI_Node& parent, const velkcore::RectT<float>& frame,
                                 boost::intrusive_ptr<Node> node) {
  node->UI_SetLocalRectF(frame);
  node->UI_Show(true);
  parent.ChildPushBack(node);
  return node;
}

}  // namespace gallery
