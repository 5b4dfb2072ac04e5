#pragma once

#include <cstdint>

#include <velkcore/Geometry.h>
#include <velkui/ui/UI_Node.h>

namespace velkui::ui {

using SubViewP = boost::intrusive_ptr<UI_SubView>;

// The concrete node with its own frame (in the parent's coordinates) and a
// scale-and-translate matrix. A new sub-view is hidden and has an empty frame.
class UI_SubView : public UI_Node {
 public:
  UI_SubView();
  ~UI_SubView() override;

  bool UI_IsSubView() const override;
  velkcore::ScaleMatrixT<float> UI_GetSelfToParentMatrix() const override;
  velkcore::RectT<std::int32_t> UI_GetLocalRect(bool inParent) const override;
  velkcore::RectT<float> UI_GetLocalRectF(bool inParent) const override;
  void UI_SetLocalRect(const velkcore::RectT<std::int32_t>& rect) override;
  void UI_SetLocalRectF(const velkcore::RectT<float>& rect) override;
  void UI_Show(bool show) override;
  bool UI_IsShown() const override;
  void UI_Invalidate(const velkcore::RectT<std::int32_t>* localOrNull,
                     InvalidateFlags flags) override;
  void UI_UpdateNow(UpdateFlags flags) override;
  void UI_SetOpacity(float opacity) override;
  void UI_SetParent(UI_Container* parent) override;
  bool UI_SupportsPictel() const override;
  void UI_SetCapture() override;
  void UI_ReleaseCapture() override;
  bool UI_ReceivesEventsFromOS() const override;
  void UI_HandleOSEvent(OS_Event* event) override;
  bool UI_DispatchEvent(OS_Event* event) override;
  void UI_SetKeyboardFocusWithOS() override;

  // ---- Appended virtual operations, in slot order ----
  /* 71 */ virtual velkcore::ScaleMatrixT<float> UI_GetMatrix() const;
  /* 72 */ virtual void UI_SetLayoutsChildren(bool layouts);
  /* 73 */ virtual void UI_SetLayoutBinding(LayoutBinding binding);
  /* 74 */ virtual void UI_SetSubViewLayoutFlags(velkcore::Flags<std::uint8_t> flags);

  void UI_SetMatrix(const velkcore::ScaleMatrixT<float>& matrix);
  void UI_SetMatrixOnlyForChildren(bool onlyForChildren);
  bool UI_GetMatrixOnlyForChildren() const { return matrixOnlyForChildren_; }
  bool UI_GetLayoutsChildren() const { return viewFlags_.IsSet(kViewLayoutsChildren); }
  LayoutBinding UI_GetLayoutBinding() const { return layoutBinding_; }
  velkcore::Flags<std::uint8_t> UI_GetSubViewLayoutFlags() const { return subViewLayoutFlags_; }
  ViewFlags UI_GetViewFlags() const { return viewFlags_; }

 protected:
  /* 75 */ virtual void UI_LayoutChildren(const velkcore::PointT<float>& oldSize,
                                          const velkcore::PointT<float>& newSize);

 private:
  void RemoveSubtreeTimers();
  // Whether `area` (parent coordinates) was already asked of `parent` in this
  // repaint generation; records it otherwise.
  bool IsAreaAlreadyRequested(const UI_Node& parent, const velkcore::RectT<std::int32_t>& area);

  ViewFlags viewFlags_;
  LayoutBinding layoutBinding_;
  velkcore::Flags<std::uint8_t> subViewLayoutFlags_;
  velkcore::RectT<float> localRect_;
  velkcore::ScaleMatrixT<float> matrix_;
  bool matrixOnlyForChildren_ = false;
  // Frame changes under way on this node: a handler may set another frame from inside one.
  std::uint8_t frameChangeDepth_ = 0;
  // The last area this node asked its parent to repaint, and when.
  std::uint64_t requestedSeed_ = 0;
  const UI_Node* requestedParent_ = nullptr;
  velkcore::RectT<std::int32_t> requestedArea_;
};

}  // namespace velkui::ui
