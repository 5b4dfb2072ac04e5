#pragma once

#include <cmath>
#include <limits>
#include <memory>
#include <vector>

#include <gtest/gtest.h>

#include <velkui/arrange/DefaultGroup.h>
#include <velkui/arrange/DynamicGroup.h>
#include <velkui/arrange/Groups.h>
#include <velkui/arrange/Single.h>
#include <velkui/test/ErrorOf.h>

namespace velkui::arrange::test {

// A leaf of fixed natural size that records every placement.
class Box : public Single {
 public:
  Box(float width, float height) : width_(width), height_(height) {}

  float NaturalWidth() const override { return width_; }
  float NaturalHeight() const override { return height_; }
  float MinWidth() const override { return minWidth_ >= 0 ? minWidth_ : width_; }
  float MinHeight() const override { return height_; }
  bool HorizontallyExpandable() const override { return growsH_; }
  bool VerticallyExpandable() const override { return growsV_; }
  float ExpandedWidth(float available) const override {
    const float w = Single::ExpandedWidth(available);
    return growsH_ && w > capWidth_ ? capWidth_ : w;
  }
  float LeftMargin() const override { return margin_; }
  float RightMargin() const override { return margin_; }
  float TopMargin() const override { return margin_; }
  float BottomMargin() const override { return margin_; }
  void Place(const RectF& rect) override {
    places.push_back(rect);
    if (onPlace) onPlace(*this, rect);
  }

  Box& Grows(bool horizontally, bool vertically = false) {
    growsH_ = horizontally;
    growsV_ = vertically;
    return *this;
  }
  Box& CappedAt(float width) {
    capWidth_ = width;
    return *this;
  }
  Box& WithMinWidth(float width) {
    minWidth_ = width;
    return *this;
  }
  Box& WithMargin(float margin) {
    margin_ = margin;
    return *this;
  }
  void Resize(float width, float height) {
    width_ = width;
    height_ = height;
  }
  RectF Last() const { return places.empty() ? RectF{-1, -1, -1, -1} : places.back(); }

  std::vector<RectF> places;
  std::function<void(Box&, const RectF&)> onPlace;

 private:
  float width_;
  float height_;
  float minWidth_ = -1;
  float margin_ = 0;
  bool growsH_ = false;
  bool growsV_ = false;
  float capWidth_ = std::numeric_limits<float>::max();
};

// A separator that remembers its last frame.
class RecordingSeparator : public ISeparator {
 public:
  void SetSeparatorFrame(bool acrossColumn, const RectF& frame) override {
    across = acrossColumn;
    this->frame = frame;
    ++calls;
  }
  bool across = false;
  RectF frame{-1, -1, -1, -1};
  int calls = 0;
};

// A settable group of any kind that builds recording separators on request and records the
// position and size its outer arrangement reports.
class TestGroup : public DefaultGroup<DynamicGroup> {
 public:
  explicit TestGroup(GroupArrangementType type, bool separators = false)
      : DefaultGroup<DynamicGroup>(nullptr, type), withSeparators_(separators) {}

  ISeparator* BuildSeparator() override {
    if (!withSeparators_) return nullptr;
    built.push_back(std::make_unique<RecordingSeparator>());
    return built.back().get();
  }
  void ClearSeparators() override {
    ++clearCalls;
    built.clear();
    DefaultGroup<DynamicGroup>::ClearSeparators();
  }
  void Position(const PointF& p) override { position = p; }
  void SetDimensions(const PointF& s) override { dimensions = s; }

  void Hold(std::vector<IArrangeable*> children) { SetChildren(children); }

  std::vector<std::unique_ptr<RecordingSeparator>> built;
  int clearCalls = 0;
  PointF position{-1, -1};
  PointF dimensions{-1, -1};

 private:
  bool withSeparators_;
};

// Leaves of the given sizes held, in order, by a group of the given type.
class Held {
 public:
  Held(GroupArrangementType type, const std::vector<PointF>& sizes, bool separators = false)
      : group(type, separators) {
    std::vector<IArrangeable*> children;
    for (const PointF& size : sizes) {
      leaves.push_back(std::make_unique<Box>(size.x, size.y));
      children.push_back(leaves.back().get());
    }
    group.Hold(children);
  }
  Box& operator[](std::size_t i) { return *leaves.at(i); }

  std::vector<std::unique_ptr<Box>> leaves;
  TestGroup group;
};

inline bool HasNaN(const RectF& r) {
  return std::isnan(r.left) || std::isnan(r.top) || std::isnan(r.width) || std::isnan(r.height);
}

#define EXPECT_CONTRACT_VIOLATION(statement) \
  EXPECT_TRUE(::velkui::test::RaisesContractViolation([&] { statement; }))

}  // namespace velkui::arrange::test
