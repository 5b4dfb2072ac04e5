#include <cmath>
#include <optional>

#include <velkcore/Error.h>
#include <velkui/pictel/CacheInterface.h>
#include <velkui/pictel/PathInterface.h>
#include <velkui/pictel/Pictel.h>
#include <velkui/pictel/SupplierInterface.h>
#include <velkui/pictel/SurfaceInterface.h>
#include <velkui/ui/Theme.h>
#include <velkui/ui/UI_Node.h>
#include <velkui/ui/UI_NodeManager.h>

#include "NodeGeometry.h"
#include "NodeHold.h"

namespace velkui::ui {

using velkcore::RectT;
using velkcore::ScaleMatrixT;

namespace {

pictel::SurfaceInterface& RequireSurface(pictel::Pictel* context) {
  velkcore::RequireInput(context != nullptr && context->GetSurface() != nullptr);
  return *context->GetSurface();
}

// Whether a child whose box (this node's coordinates) is `box` cannot share a
// whole unit with `clip`. Conservative: the exact test runs in the child's
// coordinates on rectangles rounded outwards there, so two child units of slack
// (plus one for the parent's own rounding) are allowed.
template <typename Box>
bool IsSurelyOutsideClip(const Box& box, const RectT<std::int32_t>& clip) {
  const float slackX = 2.0f * std::fabs(box.toParent.sx) + 1.0f;
  const float slackY = 2.0f * std::fabs(box.toParent.sy) + 1.0f;
  return box.right + slackX <= static_cast<float>(clip.left) ||
         box.left - slackX >= static_cast<float>(clip.left + clip.width) ||
         box.bottom + slackY <= static_cast<float>(clip.top) ||
         box.top - slackY >= static_cast<float>(clip.top + clip.height);
}

}  // namespace

void UI_Node::DrawChildren(pictel::Pictel* context) const {
  pictel::SurfaceInterface& surface = RequireSurface(context);
  const RectT<std::int32_t> clip = surface.GetClipBounds();
  // Children that cannot reach the clip are passed over on their cached boxes,
  // before any of their code runs. By index: drawing must not change the tree,
  // but if it does the loop stays within the list.
  for (std::size_t i = 0; i < ChildSize(); ++i) {
    const ChildBox box = GetChildBoxes()[i];
    if (!box.visible || box.ownsPlatformWindow || IsSurelyOutsideClip(box, clip)) continue;
    DrawChild(*ChildGet(i), context);
  }
}

void UI_Node::UI_DispatchDrawToChild(const UI_Node& child, pictel::Pictel* context) const {
  DrawChild(child, context);
}

void UI_Node::DrawChild(const UI_Node& child, pictel::Pictel* context) const {
  if (child.UI_ReceivesEventsFromOS() || !child.UI_IsShown()) return;
  const ScaleMatrixT<float> toParent = child.UI_GetSelfToParentMatrix();
  if (detail::IsDegenerate(toParent)) return;

  pictel::SurfaceInterface& surface = RequireSurface(context);
  const NodeP keep = detail::Hold(&child);
  const pictel::ScopedSurfaceState state(surface);
  surface.Transform(detail::ToAffine(toParent));
  if (!surface.IsWithinClipBounds(detail::RoundOut(child.UI_GetLocalRectF(false)))) return;
  UI_DrawAndCache(child, context, false, nullptr);
}

void UI_Node::UI_DispatchDraw(pictel::Pictel* context) const {
  RequireSurface(context);
  if (!UI_IsShown()) return;
  UI_DrawAndCache(*this, context, false, nullptr);
}

void UI_Node::UI_DispatchDrawFromRoot(const pictel::ColorRGBA& background, pictel::Pictel* context,
                                      bool backgroundMode) const {
  RequireSurface(context);
  // A paint ends a generation of invalidations: requests made before it (and
  // during it) must travel up again afterwards.
  struct GenerationBoundary {
    explicit GenerationBoundary(UI_NodeManager* m) : manager(m) { Advance(); }
    ~GenerationBoundary() { Advance(); }
    void Advance() const {
      if (manager != nullptr) manager->IncrementPictelCacheSeed();
    }
    UI_NodeManager* manager;
  };
  const GenerationBoundary boundary(UI_NodeManager::Get(false));
  UI_DrawAndCache(*this, context, backgroundMode, &background);
}

void UI_Node::UI_DrawAndCache(const UI_Node& node, pictel::Pictel* context, bool backgroundMode,
                              const pictel::ColorRGBA* background) {
  pictel::SurfaceInterface& surface = RequireSurface(context);
  if (!node.UI_UsePictelCache(context)) {
    UI_DrawSelf(node, context, backgroundMode, background);
    return;
  }
  if (node.cache_ && node.UI_IsPictelCacheValid(surface)) {
    surface.DrawCache(*node.cache_);
    return;
  }
  node.cache_.reset();
  const boost::intrusive_ptr<pictel::CacheInterface> cache =
      surface.PushCacheStack(node.UI_GetLocalRectF(false));
  pictel::SurfaceInterface* cacheSurface = cache ? cache->GetSurface() : nullptr;
  if (cacheSurface == nullptr) {
    surface.PopCacheStack(cache.get());
    UI_DrawSelf(node, context, backgroundMode, background);
    return;
  }
  try {
    pictel::Pictel cacheContext(context->GetSupplier(), cacheSurface);
    UI_DrawSelf(node, &cacheContext, backgroundMode, background);
  } catch (...) {
    surface.PopCacheStack(cache.get());
    throw;
  }
  surface.PopCacheStack(cache.get());

  UI_NodeManager* manager = UI_NodeManager::Get(false);
  node.cache_ = cache;
  node.cacheThemeChangeCount_ = GetThemeChangeCount();
  // A new generation: every node's record of "already invalidated" is now
  // stale, so the next invalidation below or at this node reaches this cache.
  if (manager != nullptr) manager->IncrementPictelCacheSeed();
  surface.DrawCache(*cache);
}

void UI_Node::UI_DrawSelf(const UI_Node& node, pictel::Pictel* context, bool backgroundMode,
                          const pictel::ColorRGBA* background) {
  pictel::SurfaceInterface& surface = RequireSurface(context);
  std::optional<pictel::ScopedSurfaceState> clipState;
  if (node.clipToSelf_) {
    clipState.emplace(surface);
    node.UI_ClipToSelf(context);
  }
  if (backgroundMode) {
    if (background != nullptr && background->alpha > 0.0f) {
      surface.PaintRect(*background, node.UI_GetLocalRectF(false));
    }
    node.DrawChildren(context);
    return;
  }
  bool drawn = false;
  if (node.customDraw_) {
    const std::shared_ptr<CustomDrawFunction> f = node.customDraw_;
    drawn = (*f)(&node, context);
  }
  if (!drawn) node.UI_Draw(context);
}

void UI_Node::UI_ClipToSelf(pictel::Pictel* context) const {
  pictel::SurfaceInterface& surface = RequireSurface(context);
  const pictel::SupplierInterface* supplier =
      context->GetSupplier() != nullptr ? context->GetSupplier() : surface.GetSupplier();
  velkcore::RequireInput(supplier != nullptr);
  const boost::intrusive_ptr<pictel::PathInterface> path = supplier->NewPath();
  path->AddRect(UI_GetLocalRectF(false));
  surface.Clip(*path, pictel::FillType::kWinding);
}

}  // namespace velkui::ui
