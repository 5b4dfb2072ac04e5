#include <velkui/arrange/AbstractArrangeableGroup.h>

#include <algorithm>

#include <velkcore/Error.h>
#include <velkui/arrange/GroupArrangement.h>

#include "CombinationEnumerator.h"

namespace velkui::arrange::impl {

AbstractArrangeableGroup::AbstractArrangeableGroup(IArrangeable* parent) : IArrangeable(parent) {}

AbstractArrangeableGroup::~AbstractArrangeableGroup() {
  DetachCandidates();
}

void AbstractArrangeableGroup::DetachCandidates() {
  for (const IArrangementP& a : arrangements_) {
    if (auto* group = dynamic_cast<GroupArrangement*>(a.get())) {
      group->DetachGroup();
      group->DetachSeparators();
    }
  }
}

void AbstractArrangeableGroup::ReleaseCandidates() {
  DetachCandidates();
  arrangements_.Clear();
}

void AbstractArrangeableGroup::ClearSeparators() {
  for (const IArrangementP& a : arrangements_) {
    if (auto* group = dynamic_cast<GroupArrangement*>(a.get())) group->DetachSeparators();
  }
  separators_.clear();
  if (IsRebuilding()) return;
  // The candidates point at the separators: they go with them.
  ReleaseCandidates();
  MarkInvalid();
}

void AbstractArrangeableGroup::BuildSeparators() {
  separators_.clear();
  ClearSeparators();
  separators_.clear();
  const std::size_t gaps = children_.empty() ? 0 : children_.size() - 1;
  separators_.reserve(gaps);
  for (std::size_t i = 0; i < gaps; ++i) separators_.push_back(BuildSeparator());
  if (!IsRebuilding()) Invalidate();
}

void AbstractArrangeableGroup::SetChildren(const std::vector<IArrangeable*>& children) {
  for (IArrangeable* child : children) {
    velkcore::RequireInput(child != nullptr);
    child->SetParent(this);  // raises the contract violation on a cycle
  }
  children_ = children;
  Invalidate();
}

bool AbstractArrangeableGroup::VisitChildren(const std::function<bool(IArrangeable&)>& visit) {
  for (IArrangeable* child : children_) {
    if (!visit(*child)) return false;
  }
  return true;
}

bool AbstractArrangeableGroup::VisitChildren(
    const std::function<bool(const IArrangeable&)>& visit) const {
  for (const IArrangeable* child : children_) {
    if (!visit(*child)) return false;
  }
  return true;
}

void AbstractArrangeableGroup::ChildDestroyed(IArrangeable& child) {
  children_.erase(std::remove(children_.begin(), children_.end(), &child), children_.end());
  ReleaseCandidates();
  MarkInvalid();
}

void AbstractArrangeableGroup::RebuildSelf() {
  for (IArrangeable* child : children_) child->SetParent(this);
  // Separators first: the old candidates, which may still be in use by an arrangement under
  // way, let go of the old separators before the host destroys them.
  if (!children_.empty() && separators_.size() != children_.size() - 1) BuildSeparators();
  ReleaseCandidates();

  CombinationEnumerator enumerator(*this);
  enumerator.Run(
      [this](const Combination& combination) { BuildArrangements(combination, arrangements_); });
  for (const IArrangementP& a : arrangements_) a->Compute();
}

}  // namespace velkui::arrange::impl
