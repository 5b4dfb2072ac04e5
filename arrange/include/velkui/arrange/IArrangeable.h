#pragma once

#include <functional>

#include <velkui/arrange/ArrangeTypes.h>
#include <velkui/arrange/ArrangementSet.h>

namespace velkui::arrange {

// Base of everything the engine can arrange: leaves (Single) and groups. A tree of arrangeables
// is always arranged from its root; invalidating any part of it re-arranges the root once.
class IArrangeable {
 public:
  explicit IArrangeable(IArrangeable* parent = nullptr);
  virtual ~IArrangeable();
  IArrangeable(const IArrangeable&) = delete;
  IArrangeable& operator=(const IArrangeable&) = delete;

  // Raises the contract violation when `parent` is this object or one of its descendants.
  void SetParent(IArrangeable* parent);
  IArrangeable* Parent() { return parent_; }
  const IArrangeable* Parent() const { return parent_; }

  // The candidate set, rebuilt first when it is out of date.
  impl::ArrangementSet& Arrangements();

  // Arranges the whole tree from its root inside `rect`; returns the size used. A rectangle
  // without positive width and height, or a disabled root, arranges nothing.
  PointF Arrange(const RectF& rect);
  // Arranges the root again at the rectangle it was last given.
  void Rearrange();
  PointF BestSize();
  // Only the root's flag counts; enabling it again re-arranges once.
  void EnableArrangement(bool enable);
  bool ArrangementEnabled() const;
  // Marks this object and its ancestors out of date and re-arranges the root once, unless the
  // root is disabled or already busy (then the busy arrangement repeats instead).
  void Invalidate();
  // Marks every descendant out of date too, then invalidates this object.
  void InvalidateAll();

  bool IsValid() const { return valid_; }
  const RectF& LastRectangle() const { return lastRect_; }

  // Call `visit` for each child until it returns false; returns false when it was stopped.
  virtual bool VisitChildren(const std::function<bool(IArrangeable&)>& visit);
  virtual bool VisitChildren(const std::function<bool(const IArrangeable&)>& visit) const;

 protected:
  virtual void RebuildSelf() {}
  virtual impl::ArrangementSet& ArrangementsSelf() = 0;

  // A child is being destroyed: forget everything that refers to it. The default marks this
  // object out of date.
  virtual void ChildDestroyed(IArrangeable& child);

  // Marks this object and its ancestors out of date without arranging anything; an arranging
  // root is told to run one more pass.
  void MarkInvalid();
  bool IsRebuilding() const { return rebuilding_; }

 private:
  IArrangeable& Root();
  void LinkToParent();
  void UnlinkFromParent();
  void MarkInvalidUpwards();
  void MarkDescendantsInvalid();
  PointF ArrangeAsRoot(const RectF& rect);
  void RearrangeIfRequested();

  bool valid_ = false;
  bool enabled_ = true;
  RectF lastRect_{};
  IArrangeable* parent_ = nullptr;
  // Every object whose parent pointer names this one, so that neither side of a parent link
  // can outlive the other with a dangling pointer.
  IArrangeable* firstLinked_ = nullptr;
  IArrangeable* nextLinked_ = nullptr;
  IArrangeable* previousLinked_ = nullptr;

  // Root bookkeeping against re-entrance: while busy, invalidations only mark the tree and
  // request another pass instead of arranging from inside an arrangement.
  int busy_ = 0;
  bool passRequested_ = false;
  bool rebuilding_ = false;
  PointF lastResult_{};
};

bool VisitChildren(IArrangeable& arrangeable, const std::function<bool(IArrangeable&)>& visit);
bool VisitChildren(const IArrangeable& arrangeable,
                   const std::function<bool(const IArrangeable&)>& visit);
IArrangeable* Parent(IArrangeable& arrangeable);

}  // namespace velkui::arrange
