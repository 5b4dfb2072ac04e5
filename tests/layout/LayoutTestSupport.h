#pragma once

// Shared by the layout tests: sub-views of fixed recommended size that log the frames they
// are given, and elements of composed layouts that record where they were put.

#include <string>
#include <utility>
#include <vector>

#include <gtest/gtest.h>

#include <velkcore/Error.h>
#include <velkcore/Geometry.h>
#include <velkcore/RefCountedObject.h>
#include <velkui/layout/SmartLayout.h>
#include <velkui/test/ErrorOf.h>
#include <velkui/ui/UI_ArrangementView.h>
#include <velkui/ui/UI_SubView.h>

namespace velkui::layout::test {

using velkcore::PointT;
using velkcore::RectT;

// A sub-view that recommends a fixed size and counts the frames it is given.
class FixedView : public ui::UI_SubView {
 public:
  explicit FixedView(const RectT<float>& frame, PointT<float> recommended = {0, 0})
      : recommended_(recommended) {
    UI_SetLocalRectF(frame);
    UI_Show(true);
  }

  PointT<float> UI_GetRecommendedSize(pictel::Pictel*) override { return recommended_; }
  void UI_SizeChanged(const RectT<float>& r) override {
    ++frameChanges;
    frames.push_back(r);
  }
  void SetRecommended(PointT<float> size) { recommended_ = size; }

  int frameChanges = 0;
  std::vector<RectT<float>> frames;

 private:
  PointT<float> recommended_;
};

inline boost::intrusive_ptr<FixedView> AddFixed(ui::UI_Node* parent, const RectT<float>& frame,
                                                PointT<float> recommended = {0, 0}) {
  auto view = velkcore::MakeIntrusive<FixedView>(frame, recommended);
  if (parent != nullptr) parent->ChildPushBack(view);
  return view;
}

// An element of fixed initial size that records the rectangles it receives.
class RecordingLayout : public SmartLayout {
 public:
  explicit RecordingLayout(PointT<float> size) : SmartLayout(size) {}
  void SetLocation(const RectT<float>& rect) override { locations.push_back(rect); }
  RectT<float> Last() const {
    return locations.empty() ? RectT<float>{-1, -1, -1, -1} : locations.back();
  }

  std::vector<RectT<float>> locations;
};

inline boost::intrusive_ptr<RecordingLayout> Recording(float width, float height) {
  return velkcore::MakeIntrusive<RecordingLayout>(PointT<float>{width, height});
}

inline std::string Describe(const RectT<float>& r) {
  auto f = [](float v) {
    std::string s = std::to_string(v);
    s.erase(s.find_last_not_of('0') + 1);
    if (s.back() == '.') s.pop_back();
    return s;
  };
  return "(" + f(r.left) + "," + f(r.top) + " " + f(r.width) + "x" + f(r.height) + ")";
}

// Compares rectangles through their text, so that failures show both.
#define EXPECT_RECT(actual, l, t, w, h)               \
  EXPECT_EQ(::velkui::layout::test::Describe(actual), \
            ::velkui::layout::test::Describe(::velkcore::RectT<float>{l, t, w, h}))

#define EXPECT_SAME_RECT(actual, expected) \
  EXPECT_EQ(::velkui::layout::test::Describe(actual), ::velkui::layout::test::Describe(expected))

#define EXPECT_CONTRACT_VIOLATION(statement) \
  EXPECT_TRUE(::velkui::test::RaisesContractViolation([&] { statement; }))

// A window stand-in (0, 0, 400, 300) holding a panel at (30, 40), into which arrangement views
// go: a view made at its default frame has its origin at (40, 60) in global coordinates.
class ArrangementPanelTest : public ::testing::Test {
 protected:
  template <typename View = ui::UI_ArrangementView>
  boost::intrusive_ptr<View> MakeView(arrange::GroupArrangementType type,
                                      RectT<float> frame = {10, 20, 200, 100}) {
    auto view = velkcore::MakeIntrusive<View>(type);
    view->UI_SetLocalRectF(frame);
    view->UI_Show(true);
    return view;
  }

  void Attach(const ui::ArrangementViewP& view) { panel->ChildPushBack(view); }

  boost::intrusive_ptr<FixedView> host = AddFixed(nullptr, {0, 0, 400, 300});
  boost::intrusive_ptr<FixedView> panel = AddFixed(host.get(), {30, 40, 300, 200});
};

}  // namespace velkui::layout::test
