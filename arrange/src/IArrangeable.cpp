#include <velkui/arrange/IArrangeable.h>

#include <cmath>
#include <optional>

#include <velkcore/Error.h>

namespace velkui::arrange {

namespace {

constexpr int kMaxArrangePasses = 5;

bool IsFinite(const RectF& r) {
  return std::isfinite(r.left) && std::isfinite(r.top) && std::isfinite(r.width) &&
         std::isfinite(r.height);
}

// Counts a root as busy (arranging or rebuilding) for the lifetime of the scope.
class BusyScope {
 public:
  explicit BusyScope(int& counter) : counter_(counter) { ++counter_; }
  ~BusyScope() { --counter_; }
  BusyScope(const BusyScope&) = delete;
  BusyScope& operator=(const BusyScope&) = delete;

 private:
  int& counter_;
};

}  // namespace

IArrangeable::IArrangeable(IArrangeable* parent) : parent_(parent) {
  LinkToParent();
}

IArrangeable::~IArrangeable() {
  while (firstLinked_ != nullptr) firstLinked_->SetParent(nullptr);
  if (parent_ != nullptr) {
    IArrangeable* parent = parent_;
    UnlinkFromParent();
    parent_ = nullptr;
    parent->ChildDestroyed(*this);
  }
}

void IArrangeable::LinkToParent() {
  if (parent_ == nullptr) return;
  nextLinked_ = parent_->firstLinked_;
  previousLinked_ = nullptr;
  if (nextLinked_ != nullptr) nextLinked_->previousLinked_ = this;
  parent_->firstLinked_ = this;
}

void IArrangeable::UnlinkFromParent() {
  if (parent_ == nullptr) return;
  if (previousLinked_ != nullptr) {
    previousLinked_->nextLinked_ = nextLinked_;
  } else {
    parent_->firstLinked_ = nextLinked_;
  }
  if (nextLinked_ != nullptr) nextLinked_->previousLinked_ = previousLinked_;
  nextLinked_ = nullptr;
  previousLinked_ = nullptr;
}

void IArrangeable::SetParent(IArrangeable* parent) {
  if (parent == parent_) return;
  for (const IArrangeable* a = parent; a != nullptr; a = a->parent_) {
    velkcore::RequireInput(a != this);
  }
  UnlinkFromParent();
  parent_ = parent;
  LinkToParent();
}

IArrangeable& IArrangeable::Root() {
  IArrangeable* node = this;
  while (node->parent_ != nullptr) node = node->parent_;
  return *node;
}

impl::ArrangementSet& IArrangeable::Arrangements() {
  if (!valid_) {
    // A child rebuilt by its rebuilding parent is already inside the root's busy section.
    IArrangeable* root = (parent_ != nullptr && parent_->rebuilding_) ? nullptr : &Root();
    {
      std::optional<BusyScope> busy;
      if (root != nullptr) busy.emplace(root->busy_);
      valid_ = true;
      rebuilding_ = true;
      try {
        RebuildSelf();
      } catch (...) {
        valid_ = false;
        rebuilding_ = false;
        throw;
      }
      rebuilding_ = false;
    }
    if (root != nullptr) root->RearrangeIfRequested();
  }
  return ArrangementsSelf();
}

PointF IArrangeable::Arrange(const RectF& rect) {
  return Root().ArrangeAsRoot(rect);
}

PointF IArrangeable::ArrangeAsRoot(const RectF& rect) {
  if (!(rect.width > 0 && rect.height > 0)) return {0, 0};
  velkcore::RequireInput(IsFinite(rect));
  // Kept while disabled too, so that enabling arranges at the size the host last gave.
  lastRect_ = rect;
  if (!enabled_) return {0, 0};
  if (busy_ > 0) {
    // Asked from inside an arrangement: run another pass instead of re-entering.
    passRequested_ = true;
    return lastResult_;
  }
  BusyScope busy(busy_);
  for (int pass = 0; pass < kMaxArrangePasses; ++pass) {
    passRequested_ = false;
    // Held for the pass: the host may drop the tree's candidates while it is being placed.
    const impl::IArrangementP chosen(Arrangements().ChooseFor({lastRect_.width, lastRect_.height}));
    if (!chosen) break;
    lastResult_ = chosen->Arrange(lastRect_);
    if (!passRequested_ || !enabled_) break;
  }
  passRequested_ = false;
  return lastResult_;
}

void IArrangeable::RearrangeIfRequested() {
  if (busy_ > 0 || !passRequested_) return;
  passRequested_ = false;
  if (enabled_) ArrangeAsRoot(lastRect_);
}

void IArrangeable::Rearrange() {
  IArrangeable& root = Root();
  root.ArrangeAsRoot(root.lastRect_);
}

PointF IArrangeable::BestSize() {
  return Arrangements().BestSize();
}

void IArrangeable::EnableArrangement(bool enable) {
  IArrangeable& root = Root();
  if (root.enabled_ == enable) return;
  root.enabled_ = enable;
  if (enable) root.Rearrange();
}

bool IArrangeable::ArrangementEnabled() const {
  const IArrangeable* node = this;
  while (node->parent_ != nullptr) node = node->parent_;
  return node->enabled_;
}

void IArrangeable::Invalidate() {
  IArrangeable& root = Root();
  // Only the call that disabled the root enables it again, so a burst of nested
  // invalidations arranges once, after the whole tree is marked.
  const bool ownsBatch = root.enabled_ && root.busy_ == 0;
  if (ownsBatch) root.enabled_ = false;
  MarkInvalidUpwards();
  if (root.busy_ > 0) root.passRequested_ = true;
  if (ownsBatch) root.EnableArrangement(true);
}

void IArrangeable::InvalidateAll() {
  MarkDescendantsInvalid();
  Invalidate();
}

void IArrangeable::MarkInvalid() {
  MarkInvalidUpwards();
  IArrangeable& root = Root();
  if (root.busy_ > 0) root.passRequested_ = true;
}

void IArrangeable::MarkInvalidUpwards() {
  IArrangeable* node = this;
  while (node != nullptr) {
    const bool wasValid = node->valid_;
    node->valid_ = false;
    IArrangeable* parent = node->parent_;
    // An ancestor can only be up to date while its descendants are, so the climb stops at the
    // first one already marked.
    if (parent == nullptr || (!wasValid && !parent->valid_)) break;
    node = parent;
  }
}

void IArrangeable::MarkDescendantsInvalid() {
  VisitChildren([](IArrangeable& child) {
    child.valid_ = false;
    child.MarkDescendantsInvalid();
    return true;
  });
}

void IArrangeable::ChildDestroyed(IArrangeable& /*child*/) {
  MarkInvalid();
}

bool IArrangeable::VisitChildren(const std::function<bool(IArrangeable&)>& /*visit*/) {
  return true;
}

bool IArrangeable::VisitChildren(const std::function<bool(const IArrangeable&)>& /*visit*/) const {
  return true;
}

bool VisitChildren(IArrangeable& arrangeable, const std::function<bool(IArrangeable&)>& visit) {
  return arrangeable.VisitChildren(visit);
}

bool VisitChildren(const IArrangeable& arrangeable,
                   const std::function<bool(const IArrangeable&)>& visit) {
  return arrangeable.VisitChildren(visit);
}

IArrangeable* Parent(IArrangeable& arrangeable) {
  return arrangeable.Parent();
}

}  // namespace velkui::arrange
