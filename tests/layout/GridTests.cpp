#include <algorithm>
#include <string>

#include <gtest/gtest.h>

#include <velkui/layout/UI_LayoutFormatter.h>
#include <velkui/pictel/Pictel.h>
#include <velkui/test/RecordingSupplier.h>
#include <velkui/ui/UI_GridView.h>

#include "LayoutTestSupport.h"

namespace velkui::layout::test {
namespace {

using ui::UI_Cell;
using ui::UI_Grid;
using ui::UI_GridView;

// A grid view 200 × 100 with margins (5, 5) and a 2 × 2 grid: columns 50 and 60 wide, rows 20
// and 30 high, so the cells lie at x 5 and 55, y 5 and 25.
class GridTest : public ::testing::Test {
 protected:
  GridTest() {
    view->SetMargins(5, 5);
    grid().SetGridSize(2, 2);
    grid().SetColumnWidth(0, 50);
    grid().SetColumnWidth(1, 60);
    grid().SetRowHeight(0, 20);
    grid().SetRowHeight(1, 30);
  }

  UI_Grid& grid() { return view->GetGrid(); }
  UI_Cell* cell(int c, int r) { return grid().GetCell(c, r); }

  boost::intrusive_ptr<velkui::test::RecordingSupplier> supplier =
      velkcore::MakeIntrusive<velkui::test::RecordingSupplier>();
  boost::intrusive_ptr<UI_GridView> view =
      velkcore::MakeIntrusive<UI_GridView>(PointT<float>{200, 100});
};

TEST(GridSizeTest, ANewGridViewHasOneCellAsLargeAsItself) {
  UI_GridView view({278, 72});
  EXPECT_EQ(view.GetGrid().GetGridSize(), (PointT<std::int32_t>{1, 1}));
  EXPECT_RECT(view.GetGridRectF(), 0, 0, 278, 72);
  EXPECT_RECT(view.GetGrid().GetCell(0, 0)->GetLocalRectF(), 0, 0, 278, 72);
}

TEST_F(GridTest, ResizingKeepsWhatRemainsAndAddsDefaults) {
  UI_Cell* kept = cell(1, 1);
  grid().SetGridSize(3, 2);
  EXPECT_EQ(cell(1, 1), kept);
  EXPECT_EQ(grid().GetColumnWidth(1), 60);
  EXPECT_EQ(grid().GetColumnWidth(2), UI_Grid::kDefaultColumnWidth);
  EXPECT_RECT(cell(2, 1)->GetLocalRectF(), 115, 25, UI_Grid::kDefaultColumnWidth, 30);
  grid().SetGridSize(1, 1);
  EXPECT_EQ(grid().GetCells().size(), 1u);
  grid().SetGridSize(0, 0);
  EXPECT_TRUE(grid().GetCells().empty());
  EXPECT_RECT(view->GetGridRectF(), 5, 5, 0, 0);
}

TEST_F(GridTest, BadSizesAndIndicesAreRefused) {
  EXPECT_CONTRACT_VIOLATION(grid().SetGridSize(-1, 2));
  EXPECT_CONTRACT_VIOLATION(grid().SetGridSize(UI_Grid::kMaxColumnsOrRows + 1, 1));
  EXPECT_CONTRACT_VIOLATION(grid().SetGridSize(5000, 5000));
  EXPECT_CONTRACT_VIOLATION(grid().GetCell(2, 0));
  EXPECT_CONTRACT_VIOLATION(grid().SetColumnWidth(0, -1));
  EXPECT_CONTRACT_VIOLATION(grid().SetRowHeight(2, 1));
  EXPECT_CONTRACT_VIOLATION(view->SetMargins(-1, 0));
  EXPECT_EQ(grid().GetGridSize(), (PointT<std::int32_t>{2, 2}));
}

TEST_F(GridTest, PointsFindTheirCellAndSelectionIsSingle) {
  std::int32_t c = 0;
  std::int32_t r = 0;
  EXPECT_EQ(grid().GetCellForPoint({55, 5}, c, r), cell(1, 0));
  EXPECT_EQ(c, 1);
  EXPECT_EQ(r, 0);
  EXPECT_EQ(grid().GetCellForPoint({54.9f, 24.9f}, c, r), cell(0, 0));
  EXPECT_EQ(grid().GetCellForPoint({115, 30}, c, r), nullptr);
  EXPECT_EQ(c, -1);
  EXPECT_EQ(r, -1);

  EXPECT_TRUE(grid().SelectCell({10, 30}, true));
  EXPECT_TRUE(grid().SelectCell({60, 30}, true));
  EXPECT_FALSE(cell(0, 1)->IsSelected());
  EXPECT_EQ(grid().GetSelectedCell(&c, &r), cell(1, 1));
  EXPECT_EQ(c, 1);
  EXPECT_EQ(r, 1);
  EXPECT_FALSE(grid().SelectCell({0, 0}, true));
  EXPECT_TRUE(grid().SelectCell({60, 30}, false));
  EXPECT_EQ(grid().GetSelectedCell(&c, &r), nullptr);
  EXPECT_EQ(c, -1);
}

TEST_F(GridTest, SizesAsText) {
  EXPECT_EQ(view->GetColumnWidthsAsString(), u"50,60");
  view->SetColumnWidthsFromString(u"12.5, 80,99,100");
  EXPECT_EQ(view->GetColumnWidthsAsString(), u"12.5,80");
  view->SetColumnWidthsFromString(u"30");
  EXPECT_EQ(view->GetColumnWidthsAsString(), u"30,80");
  view->SetColumnWidthsFromString(u",45");
  EXPECT_EQ(view->GetColumnWidthsAsString(), u"30,45");
  view->SetRowHeightsFromString(u"7,8,9");
  EXPECT_EQ(view->GetRowHeightsAsString(), u"7,8");

  EXPECT_CONTRACT_VIOLATION(view->SetColumnWidthsFromString(u"1,abc"));
  EXPECT_CONTRACT_VIOLATION(view->SetColumnWidthsFromString(u"1,-2"));
  EXPECT_CONTRACT_VIOLATION(view->SetColumnWidthsFromString(u"1,2x"));
  EXPECT_CONTRACT_VIOLATION(view->SetRowHeightsFromString(u"inf"));
  EXPECT_EQ(view->GetColumnWidthsAsString(), u"30,45");
  EXPECT_EQ(view->GetRowHeightsAsString(), u"7,8");

  // The text form reads back to the same numbers.
  grid().SetColumnWidth(0, 0.1f);
  const auto text = view->GetColumnWidthsAsString();
  grid().SetColumnWidth(0, 3);
  view->SetColumnWidthsFromString(text);
  EXPECT_EQ(grid().GetColumnWidth(0), 0.1f);
}

TEST_F(GridTest, CellsFetchTheNodesLyingInThemAndMoveThem) {
  auto a = AddFixed(view.get(), {8, 9, 10, 10});
  auto b = AddFixed(view.get(), {55, 25, 10, 10});
  auto outside = AddFixed(view.get(), {150, 80, 10, 10});
  view->UpdateGrid(supplier.get());
  EXPECT_TRUE(view->IsInitialized());
  ASSERT_EQ(cell(0, 0)->GetNodeCount(), 1u);
  EXPECT_EQ(cell(0, 0)->GetNode(0), a);
  EXPECT_EQ(cell(0, 0)->GetNodeOffset(0), (PointT<float>{3, 4}));
  EXPECT_EQ(cell(1, 1)->GetNode(0), b);
  EXPECT_TRUE(cell(1, 0)->IsEmpty());
  EXPECT_TRUE(cell(0, 1)->IsEmpty());
  EXPECT_CONTRACT_VIOLATION(cell(0, 0)->GetNode(1));

  // Without a formatter nothing moves.
  grid().SetColumnWidth(0, 70);
  view->RecalcLayout(supplier.get());
  EXPECT_RECT(b->UI_GetLocalRectF(true), 55, 25, 10, 10);
  cell(1, 1)->UpdateNodesPosition();
  EXPECT_RECT(b->UI_GetLocalRectF(true), 75, 25, 10, 10);

  // A removed child leaves its cell.
  view->ChildRemove(b.get());
  EXPECT_TRUE(cell(1, 1)->IsEmpty());
  EXPECT_EQ(outside->UI_GetParentContainer(), view.get());
}

TEST_F(GridTest, CellSizesGrowUndersizedNodesWithoutShrinkingThem) {
  auto wide = AddFixed(view.get(), {5, 5, 40, 5}, {30, 12});
  auto tall = AddFixed(view.get(), {15, 10, 10, 10}, {12, 8});
  view->UpdateGrid(supplier.get());
  auto surface = supplier->NewSurface(1, 1, true);
  pictel::Pictel context(supplier.get(), surface.get());
  EXPECT_EQ(cell(0, 0)->RecalcCellSize(&context), (PointT<float>{40, 15}));
  EXPECT_RECT(wide->UI_GetLocalRectF(true), 5, 5, 40, 12);
  EXPECT_RECT(tall->UI_GetLocalRectF(true), 15, 10, 12, 10);
  EXPECT_EQ(cell(1, 1)->RecalcCellSize(&context), (PointT<float>{0, 0}));
}

TEST_F(GridTest, TheSimpleFormatterSizesColumnsAndRowsAndGrowsTheView) {
  view->SetLayoutFormatter(velkcore::MakeIntrusive<UI_SimpleLayoutFormatter>());
  auto a = AddFixed(view.get(), {5, 5, 30, 10}, {30, 10});
  auto b = AddFixed(view.get(), {57, 27, 100, 10}, {100, 10});
  auto c = AddFixed(view.get(), {10, 28, 20, 5}, {20, 5});
  view->UpdateGrid(supplier.get());
  // Columns: the widest need + 4, even when that narrows them. Rows: raised only when lower
  // than the tallest need.
  EXPECT_EQ(grid().GetColumnWidth(0), 34);
  EXPECT_EQ(grid().GetColumnWidth(1), 106);
  EXPECT_EQ(grid().GetRowHeight(0), 20);
  EXPECT_EQ(grid().GetRowHeight(1), 30);
  EXPECT_RECT(b->UI_GetLocalRectF(true), 41, 27, 100, 10);
  EXPECT_RECT(c->UI_GetLocalRectF(true), 10, 28, 20, 5);
  EXPECT_RECT(cell(1, 1)->GetLocalRectF(), 39, 25, 106, 30);
  EXPECT_RECT(view->UI_GetLocalRectF(true), 0, 0, 200, 100);
  // The view grows to hold the cells with its margins on both sides, and never shrinks.
  b->SetRecommended({180, 40});
  view->RecalcLayout(supplier.get());
  EXPECT_EQ(grid().GetRowHeight(1), 46);
  EXPECT_RECT(cell(1, 1)->GetLocalRectF(), 39, 25, 186, 46);
  EXPECT_RECT(view->UI_GetLocalRectF(true), 0, 0, 230, 100);
  EXPECT_TRUE(cell(1, 1)->IsVisible());
  EXPECT_FALSE(view->GetLayoutFormatter()->IsFormatterInProgress());
}

TEST_F(GridTest, CellsOutsideTheInsetAreaAreHidden) {
  view->SetLayoutFormatter(velkcore::MakeIntrusive<UI_SimpleLayoutFormatter>());
  grid().SetGridSize(3, 1);
  AddFixed(view.get(), {5, 5, 90, 10}, {90, 10});
  view->UpdateGrid(supplier.get());
  // Columns 94, 4 and 4 wide: the empty ones lie inside the 190-unit inset area.
  EXPECT_TRUE(cell(2, 0)->IsVisible());
  view->UI_SetLocalRectF({0, 0, 100, 100});
  view->RecalcLayout(supplier.get());
  EXPECT_TRUE(cell(0, 0)->IsVisible());
  EXPECT_FALSE(cell(1, 0)->IsVisible());
  EXPECT_FALSE(cell(2, 0)->IsVisible());
}

TEST_F(GridTest, AFormatterInProgressDoesNothing) {
  auto formatter = velkcore::MakeIntrusive<UI_SimpleLayoutFormatter>();
  view->SetLayoutFormatter(formatter);
  AddFixed(view.get(), {5, 5, 30, 10}, {300, 10});
  formatter->SetFormatterProgressState(true);
  view->UpdateGrid(supplier.get());
  EXPECT_EQ(grid().GetColumnWidth(0), 50);
  formatter->SetFormatterProgressState(false);
  view->RecalcLayout(supplier.get());
  EXPECT_EQ(grid().GetColumnWidth(0), 304);
  EXPECT_CONTRACT_VIOLATION(view->RecalcLayout(nullptr));
}

TEST_F(GridTest, TheFlowFormatterWrapsCellsHoldingNodes) {
  view->SetLayoutFormatter(velkcore::MakeIntrusive<UI_FlowLayoutFormatter>());
  grid().SetGridSize(3, 2);
  // Columns become 80 wide (76 + 4): two cells fit across the 190-unit inset area.
  AddFixed(view.get(), {5, 5, 76, 16});
  AddFixed(view.get(), {55, 5, 76, 16});
  AddFixed(view.get(), {115, 5, 76, 16});
  auto last = AddFixed(view.get(), {55, 25, 76, 16});
  view->UpdateGrid(supplier.get());
  EXPECT_RECT(cell(0, 0)->GetLocalRectF(), 5, 5, 80, 20);
  EXPECT_RECT(cell(1, 0)->GetLocalRectF(), 85, 5, 80, 20);
  EXPECT_RECT(cell(2, 0)->GetLocalRectF(), 5, 25, 80, 20);
  EXPECT_RECT(cell(1, 1)->GetLocalRectF(), 85, 25, 80, 30);
  EXPECT_RECT(last->UI_GetLocalRectF(true), 85, 25, 76, 16);
  EXPECT_FALSE(cell(0, 1)->IsVisible());
  EXPECT_RECT(view->UI_GetLocalRectF(true), 0, 0, 200, 100);
}

TEST_F(GridTest, NodesGoIntoTheSelectedCellAndMoveBetweenCells) {
  auto loose = AddFixed(nullptr, {70, 70, 10, 10});
  view->AddNodeToSelectedCell(loose);
  EXPECT_EQ(loose->UI_GetParentContainer(), view.get());
  EXPECT_RECT(loose->UI_GetLocalRectF(true), 70, 70, 10, 10);

  view->SetAddNodeToSelectedCellMode(true);
  grid().SelectCell({60, 10}, true);
  auto placed = AddFixed(nullptr, {70, 70, 10, 10});
  view->AddNodeToSelectedCell(placed);
  EXPECT_RECT(placed->UI_GetLocalRectF(true), 55, 5, 10, 10);
  EXPECT_TRUE(cell(1, 0)->HasNode(placed.get()));

  cell(1, 0)->AddNode(placed, {4, 6});
  view->MoveNode(cell(1, 0), cell(0, 1), placed);
  EXPECT_TRUE(cell(1, 0)->IsEmpty());
  EXPECT_RECT(placed->UI_GetLocalRectF(true), 9, 31, 10, 10);

  UI_GridView other({10, 10});
  EXPECT_CONTRACT_VIOLATION(view->MoveNode(cell(0, 1), other.GetGrid().GetCell(0, 0), placed));
  EXPECT_CONTRACT_VIOLATION(view->MoveNode(cell(1, 1), cell(0, 0), placed));
  EXPECT_CONTRACT_VIOLATION(view->AddNodeToSelectedCell(nullptr));
}

TEST_F(GridTest, GuidesLieOnTheBoundaries) {
  EXPECT_EQ(view->GetColumnGuideForPosition({55, 10}), 0);
  EXPECT_EQ(view->GetColumnGuideForPosition({117.5f, 50}), 1);
  EXPECT_EQ(view->GetColumnGuideForPosition({80, 10}), -1);
  EXPECT_EQ(view->GetColumnGuideForPosition({55, 60}), -1);  // below the grid
  EXPECT_EQ(view->GetRowGuideForPosition({30, 23}), 0);
  EXPECT_EQ(view->GetRowGuideForPosition({30, 56}), 1);
  EXPECT_EQ(view->GetRowGuideForPosition({130, 25}), -1);
}

TEST_F(GridTest, BordersAreDrawnWhenSwitchedOnOrInEditMode) {
  auto surface = supplier->NewSurface(200, 100, true);
  pictel::Pictel context(supplier.get(), surface.get());
  auto strokes = [&] {
    const auto calls = supplier->GetLog().Names();
    return std::count(calls.begin(), calls.end(), std::string("StrokePath"));
  };
  view->UI_Draw(&context);
  EXPECT_EQ(strokes(), 0);

  UI_GridView::SetDrawCellBordersState(true);
  EXPECT_TRUE(UI_GridView::CanDrawCellBorders());
  view->UI_Draw(&context);
  UI_GridView::SetDrawCellBordersState(false);
  EXPECT_EQ(strokes(), 6);  // 3 vertical and 3 horizontal lines

  supplier->GetLog().Clear();
  grid().SelectCell({10, 10}, true);
  view->SetEditMode(true);
  view->UI_Draw(&context);
  EXPECT_EQ(strokes(), 10);  // the borders and one guide per boundary
  const auto all = supplier->GetLog().Strings();
  EXPECT_EQ(std::count_if(all.begin(), all.end(),
                          [](const std::string& s) { return s.rfind("PaintRect", 0) == 0; }),
            1);
}

}  // namespace
}  // namespace velkui::layout::test
