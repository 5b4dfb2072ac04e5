#include <velkui/ui/AutoLayoutSubView.h>

#include <algorithm>
#include <cmath>
#include <vector>

#include <velkcore/Error.h>

#include "NodeHold.h"

namespace velkui::ui {

using velkcore::PointT;
using velkcore::RectT;

namespace {

// Turns a sub-view's layout-children switch off for the lifetime of the scope.
class LayoutChildrenOff {
 public:
  explicit LayoutChildrenOff(UI_SubView* view)
      : view_(view), was_(view != nullptr && view->UI_GetLayoutsChildren()) {
    if (view_ != nullptr) view_->UI_SetLayoutsChildren(false);
  }
  ~LayoutChildrenOff() {
    if (view_ != nullptr) view_->UI_SetLayoutsChildren(was_);
  }
  LayoutChildrenOff(const LayoutChildrenOff&) = delete;
  LayoutChildrenOff& operator=(const LayoutChildrenOff&) = delete;

 private:
  UI_SubView* view_;
  bool was_;
};

UI_SubView* AsSubView(UI_Node* node) {
  return node->UI_IsSubView() ? static_cast<UI_SubView*>(node) : nullptr;
}

bool HasAutoLayout(const UI_SubView* view) {
  return view != nullptr && view->UI_GetSubViewLayoutFlags().IsSet(kSubViewAutoLayout);
}

void SetFrameWithoutBindings(UI_Node& node, const RectT<float>& frame) {
  const LayoutChildrenOff off(AsSubView(&node));
  node.UI_SetLocalRectF(frame);
}

// Lays out the outermost auto-layout views below `node`.
void LayoutAutoDescendants(UI_Node& node, pictel::Pictel* context) {
  const std::vector<NodeP> children(node.ChildBegin(), node.ChildEnd());
  for (const NodeP& child : children) {
    UI_SubView* view = AsSubView(child.get());
    if (HasAutoLayout(view)) {
      AutoLayoutSubView(*view, context);
    } else {
      LayoutAutoDescendants(*child, context);
    }
  }
}

// The size a child takes in the layout, after laying out what it holds.
PointT<float> LaidOutSize(UI_Node& child, pictel::Pictel* context) {
  UI_SubView* view = AsSubView(&child);
  if (HasAutoLayout(view)) {
    AutoLayoutSubView(*view, context);
    const RectT<float> frame = child.UI_GetLocalRectF(true);
    return {frame.width, frame.height};
  }
  LayoutAutoDescendants(child, context);
  const RectT<float> frame = child.UI_GetLocalRectF(true);
  const PointT<float> recommended = child.UI_GetRecommendedSize(context);
  return {recommended.x > frame.width ? std::ceil(recommended.x) : frame.width,
          recommended.y > frame.height ? std::ceil(recommended.y) : frame.height};
}

}  // namespace

void AutoLayoutSubView(const SubViewP& view, pictel::Pictel* context) {
  velkcore::RequireInput(view != nullptr);
  AutoLayoutSubView(*view, context);
}

void AutoLayoutSubView(UI_SubView& view, pictel::Pictel* context) {
  velkcore::RequireInput(context != nullptr);
  const NodeP keep = detail::Hold(&view);
  const velkcore::Flags<std::uint8_t> flags = view.UI_GetSubViewLayoutFlags();
  if (!flags.IsSet(kSubViewAutoLayout)) return;
  const bool horizontal = flags.IsSet(kSubViewAutoLayoutHorizontal);
  const LayoutChildrenOff off(&view);

  std::vector<NodeP> children(view.ChildBegin(), view.ChildEnd());
  std::stable_sort(children.begin(), children.end(), [horizontal](const NodeP& a, const NodeP& b) {
    const RectT<float> ra = a->UI_GetLocalRectF(true);
    const RectT<float> rb = b->UI_GetLocalRectF(true);
    return horizontal ? ra.left < rb.left : ra.top < rb.top;
  });

  float growthAlong = 0;
  float growthAcross = 0;
  float largestWidth = 0;
  float largestHeight = 0;
  for (const NodeP& child : children) {
    const RectT<float> before = child->UI_GetLocalRectF(true);
    const PointT<float> size = LaidOutSize(*child, context);
    RectT<float> frame{before.left, before.top, size.x, size.y};
    if (horizontal) {
      frame.left += growthAlong;
    } else {
      frame.top += growthAlong;
    }
    frame.left = std::floor(frame.left);
    frame.top = std::floor(frame.top);
    const float ownAlong = horizontal ? size.x - before.width : size.y - before.height;
    const float ownAcross = horizontal ? size.y - before.height : size.x - before.width;
    growthAlong += ownAlong;
    growthAcross = std::max(growthAcross, ownAcross);
    SetFrameWithoutBindings(*child, frame);
    largestWidth = std::max(largestWidth, size.x);
    largestHeight = std::max(largestHeight, size.y);
  }

  if (flags.IsSet(kSubViewAutoLayoutScaleChildren)) {
    for (const NodeP& child : children) {
      RectT<float> frame = child->UI_GetLocalRectF(true);
      if (horizontal) {
        frame.height = largestHeight;
      } else {
        frame.width = largestWidth;
      }
      SetFrameWithoutBindings(*child, frame);
    }
  }

  if (growthAlong == 0 && growthAcross == 0) return;
  RectT<float> frame = view.UI_GetLocalRectF(true);
  if (flags.IsSet(kSubViewAutoLayoutMaintainMargins)) {
    frame.width += horizontal ? growthAlong : growthAcross;
    frame.height += horizontal ? growthAcross : growthAlong;
  } else {
    // Measured after scaling, so that the view holds the children as they finally are.
    bool first = true;
    for (const NodeP& child : children) {
      const RectT<float> r = child->UI_GetLocalRectF(true);
      frame.width = first ? r.left + r.width : std::max(frame.width, r.left + r.width);
      frame.height = first ? r.top + r.height : std::max(frame.height, r.top + r.height);
      first = false;
    }
  }
  frame.width = std::ceil(frame.width);
  frame.height = std::ceil(frame.height);
  view.UI_SetLocalRectF(frame);
}

}  // namespace velkui::ui
