#pragma once

#include <vector>

#include <velkui/arrange/IArrangeable.h>
#include <velkui/arrange/ISeparator.h>

namespace velkui::arrange::impl {

// A container of the arrangement: keeps its children (not owned) and one separator per gap, and
// builds its candidates from every combination of its children's candidates.
//
// Spacing, margins and alignments are read when the candidates are built: a host that changes
// them must invalidate the group (DefaultGroup's setters do).
class AbstractArrangeableGroup : public IArrangeable {
 public:
  explicit AbstractArrangeableGroup(IArrangeable* parent = nullptr);
  ~AbstractArrangeableGroup() override;

  virtual float HorizontalSpacing() const { return 0; }
  virtual float VerticalSpacing() const { return 0; }
  virtual AlignmentHorizontal HorizontalAlignment() const { return AlignmentHorizontal::Left; }
  virtual AlignmentVertical VerticalAlignment() const { return AlignmentVertical::Top; }
  // One separator for a gap, or null for none; owned by the host.
  virtual ISeparator* BuildSeparator() { return nullptr; }
  // Forgets the separators. Hosts that override it destroy the separators they built and must
  // call this base version.
  virtual void ClearSeparators();
  virtual float LeftMargin() const { return 0; }
  virtual float RightMargin() const { return 0; }
  virtual float TopMargin() const { return 0; }
  virtual float BottomMargin() const { return 0; }
  // Where the group's outer arrangement was placed (its rectangle's top-left corner) and the
  // size it used, margins included.
  virtual void Position(const PointF& /*origin*/) {}
  virtual void SetDimensions(const PointF& /*size*/) {}

  // Clears the separators and asks BuildSeparator once per gap between children.
  void BuildSeparators();
  // Records the children in order and makes this group their parent; raises the contract
  // violation for a null child or one that would make a cycle.
  void SetChildren(const std::vector<IArrangeable*>& children);
  const std::vector<IArrangeable*>& Children() const { return children_; }
  const std::vector<ISeparator*>& Separators() const { return separators_; }

  bool VisitChildren(const std::function<bool(IArrangeable&)>& visit) override;
  bool VisitChildren(const std::function<bool(const IArrangeable&)>& visit) const override;

  // The candidates the group kind makes for one combination of child candidates (one per
  // child, children without candidates left out); `separators` has one entry per gap of the
  // combination and `hiddenSeparators` lists the group's separators the combination leaves
  // unused.
  struct Combination {
    std::vector<IArrangementP> children;
    std::vector<ISeparator*> separators;
    std::vector<ISeparator*> hiddenSeparators;
  };

 protected:
  // The type's candidate builder: add this group's candidates for `combination` to `set`.
  virtual void BuildArrangements(const Combination& combination, ArrangementSet& set) = 0;
  // How many candidates BuildArrangements makes for n children, each costing about n steps;
  // bounds how many combinations a rebuild builds. The default suits one candidate per line
  // length.
  virtual int CandidatesPerCombination(int childCount) const { return childCount; }

  void RebuildSelf() override;
  ArrangementSet& ArrangementsSelf() override { return arrangements_; }
  void ChildDestroyed(IArrangeable& child) override;
  // Drops every candidate (they are rebuilt on the next arrangement).
  void ReleaseCandidates();

 private:
  friend class CombinationEnumerator;
  void DetachCandidates();

  std::vector<IArrangeable*> children_;
  std::vector<ISeparator*> separators_;
  ArrangementSet arrangements_;
};

}  // namespace velkui::arrange::impl
