#include <gtest/gtest.h>

#include <velkui/ui/NodeManagerGuards.h>
#include <velkui/ui/UI_ModKeyNotifier.h>

#include "NodeTestSupport.h"

namespace velkui::ui::test {
namespace {

OS_Window* FakeWindow(int& tag) {
  // The manager only stores and compares window pointers.
  return reinterpret_cast<OS_Window*>(&tag);
}

// root > panel > {a, b}; root > c. a, b and c want focus.
class KeyboardFocusTest : public NodeTest<> {
 protected:
  LoggingViewP root = View("root", nullptr, {0, 0, 400, 400});
  LoggingViewP panel = View("panel", root.get(), {0, 0, 200, 200});
  LoggingViewP a = View("a", panel.get(), {0, 0, 50, 50});
  LoggingViewP b = View("b", panel.get(), {50, 0, 50, 50});
  LoggingViewP c = View("c", root.get(), {300, 300, 50, 50});

  void SetUp() override {
    for (LoggingView* v : {a.get(), b.get(), c.get()}) v->wantsFocus = true;
    UI_ModKeyNotifier::Get().DispatchModKeyEvent({});
    log->clear();
  }

  bool Press(std::int16_t vk, ModifierKeys modifiers = {}, UI_Node* target = nullptr) {
    log->clear();
    return UI_Node::UI_DispatchKeyboardEvent(target ? target : a.get(),
                                             Key(KeyboardEvent::kKeyDown, vk, modifiers));
  }
  EventLog Focus() const { return Only(":focus"); }
  std::string FocusedChain() const {
    std::string chain;
    for (const LoggingView* v : {root.get(), panel.get(), a.get(), b.get(), c.get()}) {
      if (v->UI_HasKeyboardFocus(false))
        chain += v->Name() + (v->UI_HasKeyboardFocus(true) ? "*" : "") + " ";
    }
    return chain;
  }
};

TEST_F(KeyboardFocusTest, KeysClimbFromTheTargetPastDisabledNodes) {
  EXPECT_FALSE(Press(65));
  EXPECT_EQ(*log, (EventLog{"a:key(a)", "panel:key(a)", "root:key(a)"}));
  panel->UI_SetDisabled(true);
  Press(65);
  EXPECT_EQ(*log, EventLog{"root:key(a)"});
  panel->UI_SetDisabled(false);
  panel->handlesKeyboard = true;
  EXPECT_TRUE(Press(65));
  EXPECT_EQ(*log, (EventLog{"a:key(a)", "panel:key(a)"}));
}

TEST_F(KeyboardFocusTest, CharactersClimbOnlyWhereNodesPassThemOn) {
  const auto typeA = [&] {
    log->clear();
    return UI_Node::UI_DispatchKeyboardEvent(a.get(),
                                             Key(KeyboardEvent::kCharacter, 65, {}, {u'a'}));
  };
  EXPECT_FALSE(typeA());
  EXPECT_EQ(*log, EventLog{"a:key(a)"});
  a->passesCharsToParent = true;
  typeA();
  EXPECT_EQ(*log, (EventLog{"a:key(a)", "panel:key(a)"}));
}

TEST_F(KeyboardFocusTest, FiltersAndTheCustomFunctionComeFirst) {
  const AddAndRemoveKeyboardEventFilterNode filter(*manager, c.get());
  Press(65);
  EXPECT_EQ(log->front(), "c:prekey(a)");
  c->handlesPreKeyboard = true;
  EXPECT_TRUE(Press(65));
  EXPECT_EQ(*log, EventLog{"c:prekey(a)"});
  c->handlesPreKeyboard = false;

  a->UI_SetCustomKeyboardEventFunction(std::make_shared<UI_Node::CustomKeyboardEventFunction>(
      [](UI_Node*, const KeyboardEvent&, bool& handled) {
        handled = true;
        return true;
      }));
  EXPECT_TRUE(Press(65));
  EXPECT_EQ(*log, EventLog{"c:prekey(a)"});
}

TEST_F(KeyboardFocusTest, AModifierChangeReachesTheNotifierAndTheCursorOnce) {
  std::vector<int> notified;
  const auto f = std::make_shared<UI_ModKeyNotifier::ModKeyChangedFunction>(
      [&](ModifierKeys keys) { notified.push_back(keys.Get()); });
  UI_ModKeyNotifier::Get().InstallModKeyChangedFunction(f);
  root->UI_DispatchMouseEvent(Mouse(MouseEvent::kMove, 310, 310, 0, 0), true);

  Press(16, kModifierShift);
  EXPECT_EQ(notified, std::vector<int>{kModifierShift});
  EXPECT_EQ(log->front(), "c:cursor(c,2)");  // the pointer rests on c
  Press(65, kModifierShift);
  EXPECT_EQ(notified, std::vector<int>{kModifierShift});
  EXPECT_EQ(log->front(), "a:key(a)");
  Press(65);
  EXPECT_EQ(notified, (std::vector<int>{kModifierShift, 0}));
  EXPECT_EQ(log->front(), "c:cursor(c,0)");
  UI_ModKeyNotifier::Get().RemoveModKeyChangedFunction(f);
}

// ---- Focus ----

TEST_F(KeyboardFocusTest, GainingFocusSetsTheChainAndNotifiesOnlyChangedNodes) {
  EXPECT_TRUE(a->UI_GainKeyboardFocus());
  EXPECT_EQ(FocusedChain(), "root panel a* ");
  EXPECT_EQ(Focus(), (EventLog{"a:focus", "panel:focus", "root:focus"}));

  int functionCalls = 0;
  b->InstallFocusChangedFunction(
      std::make_shared<UI_Node::FocusChangedFunction>([&](UI_Node* node) {
        EXPECT_EQ(node, b.get());
        ++functionCalls;
      }));
  log->clear();
  b->UI_GainKeyboardFocus();
  EXPECT_EQ(FocusedChain(), "root panel b* ");
  EXPECT_EQ(Focus(), (EventLog{"a:focus", "b:focus"}));
  EXPECT_EQ(functionCalls, 1);
  EXPECT_EQ(manager->GetPreviousKeyboardFocusNode(), a.get());

  log->clear();
  b->UI_GainKeyboardFocus();  // already the leaf: nothing
  EXPECT_TRUE(log->empty());

  // A node that does not want focus hands the request to its parent.
  auto plain = View("plain", b.get(), {0, 0, 5, 5});
  log->clear();
  EXPECT_FALSE(plain->UI_GainKeyboardFocus());
  EXPECT_EQ(manager->GetKeyboardFocusLeafNode(), b.get());
  EXPECT_TRUE(log->empty());
  b->InstallFocusChangedFunction(nullptr);  // the tree outlives this test's locals
}

TEST_F(KeyboardFocusTest, FocusMovingToAnAncestorChangesOnlyLeafStatus) {
  a->UI_GainKeyboardFocus();
  panel->wantsFocus = true;
  log->clear();
  panel->UI_GainKeyboardFocus();
  EXPECT_EQ(FocusedChain(), "root panel* ");
  EXPECT_EQ(Focus(), (EventLog{"a:focus", "panel:focus"}));
}

TEST_F(KeyboardFocusTest, LosingFocusGoesToTheParentOrClearsTheChain) {
  panel->wantsFocus = true;
  a->UI_GainKeyboardFocus();
  a->UI_LoseKeyboardFocus();
  EXPECT_EQ(FocusedChain(), "root panel* ");

  panel->wantsFocus = false;
  a->UI_GainKeyboardFocus();
  log->clear();
  a->UI_LoseKeyboardFocus();
  EXPECT_EQ(FocusedChain(), "");
  EXPECT_EQ(manager->GetKeyboardFocusLeafNode(), nullptr);
  EXPECT_EQ(manager->GetPreviousKeyboardFocusNode(), a.get());
  EXPECT_EQ(Focus(), (EventLog{"a:focus", "panel:focus", "root:focus"}));
}

TEST_F(KeyboardFocusTest, LosingFocusThatANodeDoesNotHaveChangesNothing) {
  panel->wantsFocus = true;
  c->UI_GainKeyboardFocus();
  log->clear();
  a->UI_LoseKeyboardFocus();  // would otherwise hand focus to the panel
  panel->UI_UpdateKeyboardFocusStateDueToLoss();
  EXPECT_EQ(FocusedChain(), "root c* ");
  EXPECT_TRUE(log->empty());

  // The parent declines but an ancestor takes focus: the chain is not cleared.
  root->wantsFocus = true;
  panel->wantsFocus = false;
  a->UI_GainKeyboardFocus();
  a->UI_LoseKeyboardFocus();
  EXPECT_EQ(FocusedChain(), "root* ");
}

TEST_F(KeyboardFocusTest, GroupedFocusChangesReachListenersAsOneChange) {
  a->UI_GainKeyboardFocus();
  {
    const GroupingFocusChanges group(*manager, false);
    EXPECT_TRUE(manager->IsGroupingFocusChanges());
    EXPECT_EQ(manager->GetKeyboardFocusLeafNode(), nullptr);
    log->clear();
    {
      const GroupingFocusChanges nested(*manager, true);  // does nothing
      b->UI_GainKeyboardFocus();
      c->UI_GainKeyboardFocus();
    }
    EXPECT_TRUE(Focus().empty());
    EXPECT_TRUE(manager->IsGroupingFocusChanges());
  }
  EXPECT_FALSE(manager->IsGroupingFocusChanges());
  EXPECT_EQ(FocusedChain(), "root c* ");
  EXPECT_EQ(Focus(), (EventLog{"c:focus", "root:focus"}));

  {
    const GroupingFocusChanges group(*manager, true);
    a->UI_GainKeyboardFocus();
    log->clear();
  }
  EXPECT_EQ(FocusedChain(), "root c* ");
  EXPECT_EQ(Focus(), (EventLog{"c:focus", "root:focus"}));
}

TEST_F(KeyboardFocusTest, ModalWindowsGiveFocusBackWhenTheyPop) {
  int first = 0;
  int second = 0;
  a->UI_GainKeyboardFocus();
  manager->PushModalWindow(FakeWindow(first));
  manager->PushModalWindow(FakeWindow(first));  // already on top
  b->UI_GainKeyboardFocus();
  manager->PushModalWindow(FakeWindow(second));
  c->UI_GainKeyboardFocus();
  EXPECT_EQ(manager->GetModalWindow(), FakeWindow(second));

  // The inner window goes first (out of order): the outer one restores to a.
  manager->PopModalWindow(FakeWindow(first));
  EXPECT_EQ(manager->GetKeyboardFocusLeafNode(), c.get());
  manager->PopModalWindow(FakeWindow(second));
  EXPECT_EQ(manager->GetKeyboardFocusLeafNode(), a.get());
  EXPECT_FALSE(manager->HasModalWindow());
  manager->PopModalWindow(FakeWindow(second));  // empty stack: nothing
  EXPECT_EQ(manager->GetKeyboardFocusLeafNode(), a.get());

  {
    const SetModalWindow modal(*manager, FakeWindow(first));
    EXPECT_EQ(manager->GetModalWindow(), FakeWindow(first));
  }
  EXPECT_FALSE(manager->HasModalWindow());
}

TEST_F(KeyboardFocusTest, ASavedFocusNodeThatDiesIsForgotten) {
  int window = 0;
  auto doomed = View("doomed", panel.get(), {0, 100, 20, 20});
  doomed->wantsFocus = true;
  doomed->UI_GainKeyboardFocus();
  manager->PushModalWindow(FakeWindow(window));
  c->UI_GainKeyboardFocus();
  panel->ChildRemove(doomed.get());
  doomed.reset();
  manager->PopModalWindow(FakeWindow(window));
  EXPECT_EQ(manager->GetKeyboardFocusLeafNode(), nullptr);
  EXPECT_EQ(manager->GetPreviousKeyboardFocusNode(), c.get());
  EXPECT_EQ(FocusedChain(), "");
}

TEST_F(KeyboardFocusTest, ApplicationActivationSavesAndRestoresFocus) {
  std::vector<bool> activations;
  manager->InstallApplicationActivationChangedFunction(
      std::make_shared<UI_NodeManager::ActivationChangedFunction>(
          [&](bool active) { activations.push_back(active); }));
  b->UI_GainKeyboardFocus();
  manager->SetApplicationFrontmost(false);
  EXPECT_FALSE(manager->IsApplicationFrontmost());
  EXPECT_EQ(FocusedChain(), "");
  manager->SetApplicationFrontmost(true);
  EXPECT_EQ(FocusedChain(), "root panel b* ");
  EXPECT_EQ(activations, (std::vector<bool>{false, true}));

  // Telling an active application it is active again changes no focus.
  a->UI_GainKeyboardFocus();
  manager->SetApplicationFrontmost(true);
  EXPECT_EQ(FocusedChain(), "root panel a* ");
  manager->UnregisterFunctions();
  manager->SetApplicationFrontmost(false);
  EXPECT_EQ(activations.size(), 3u);
}

TEST_F(KeyboardFocusTest, RemovingTheFocusedNodeClearsItsChain) {
  b->UI_GainKeyboardFocus();
  log->clear();
  const NodeP removed = root->ChildRemove(panel.get());
  EXPECT_EQ(manager->GetKeyboardFocusLeafNode(), nullptr);
  EXPECT_FALSE(root->UI_HasKeyboardFocus(false));
  EXPECT_FALSE(b->UI_HasKeyboardFocus(false));
  EXPECT_EQ(Focus(), (EventLog{"b:focus", "panel:focus", "root:focus"}));
}

TEST_F(KeyboardFocusTest, ReplacingANodeMovesItsRoles) {
  a->UI_GainKeyboardFocus();
  root->UI_UpdateMouseOverState(Mouse(MouseEvent::kMouseOverUpdate, 10, 10, 0, 0));
  manager->AddMouseEventFilterNode(a.get());
  manager->ReplaceInAllCachedNodes(a.get(), b.get(), true);
  EXPECT_EQ(FocusedChain(), "root panel b* ");
  EXPECT_TRUE(b->UI_IsMouseOver(true));
  EXPECT_FALSE(a->UI_IsMouseOver(false));
  EXPECT_EQ(manager->GetMouseEventFilterNodes(), std::vector<UI_Node*>{b.get()});

  manager->ReplaceWindowFocusNode(b.get(), nullptr, false);
  EXPECT_EQ(manager->GetKeyboardFocusLeafNode(), nullptr);
}

// ---- Tab ----

TEST_F(KeyboardFocusTest, TabAdvancesFocusAmongSiblingsAndWraps) {
  b->UI_SetDisabled(true);
  a->UI_GainKeyboardFocus();
  const auto tab = [&](UI_Node* from, ModifierKeys modifiers = {}) {
    return UI_Node::UI_DoAdvanceKeyboardFocus(from, Key(KeyboardEvent::kKeyDown, 9, modifiers));
  };
  EXPECT_TRUE(tab(a.get()));  // b is disabled: wraps to a itself
  EXPECT_EQ(manager->GetKeyboardFocusLeafNode(), a.get());
  b->UI_SetDisabled(false);
  EXPECT_TRUE(tab(a.get()));
  EXPECT_EQ(manager->GetKeyboardFocusLeafNode(), b.get());
  EXPECT_TRUE(tab(b.get(), kModifierShift | kModifierCapsLock));
  EXPECT_EQ(manager->GetKeyboardFocusLeafNode(), a.get());
  EXPECT_EQ(manager->pendingKeyboardRemovals, 3);

  EXPECT_FALSE(tab(a.get(), kModifierControl));
  EXPECT_FALSE(UI_Node::UI_DoAdvanceKeyboardFocus(a.get(), Key(KeyboardEvent::kKeyUp, 9)));
  EXPECT_EQ(manager->GetKeyboardFocusLeafNode(), a.get());
  EXPECT_EQ(manager->pendingKeyboardRemovals, 3);
}

class OpenPanel : public LoggingView {
 public:
  using LoggingView::LoggingView;
  bool AllowFocusToAdvanceFromChildren() const override { return true; }
};

TEST_F(KeyboardFocusTest, TabLeavesAPanelThatAllowsItAndSearchesInsideSiblings) {
  auto open = MakeView<OpenPanel>(root.get(), {0, 200, 100, 100}, "open", log);
  auto inner = View("inner", open.get(), {0, 0, 10, 10});
  inner->wantsFocus = true;
  auto nested = View("nested", root.get(), {200, 0, 100, 100});
  auto deep = View("deep", nested.get(), {0, 0, 10, 10});
  deep->wantsFocus = true;
  auto hidden = View("hidden", root.get(), {0, 0, 10, 10});
  hidden->wantsFocus = true;
  hidden->UI_Show(false);
  // root children: panel, c, open, nested, hidden

  inner->UI_GainKeyboardFocus();
  EXPECT_TRUE(UI_Node::UI_DoAdvanceKeyboardFocus(inner.get(), Key(KeyboardEvent::kKeyDown, 9)));
  EXPECT_EQ(manager->GetKeyboardFocusLeafNode(), deep.get());
  // From deep (inside a panel that keeps focus within): wraps inside it.
  EXPECT_TRUE(UI_Node::UI_DoAdvanceKeyboardFocus(deep.get(), Key(KeyboardEvent::kKeyDown, 9)));
  EXPECT_EQ(manager->GetKeyboardFocusLeafNode(), deep.get());
  // Around the root's list: past the hidden node to the first panel's first child.
  EXPECT_TRUE(UI_AdvanceFocus(true, 3, root.get()));
  EXPECT_EQ(manager->GetKeyboardFocusLeafNode(), a.get());
  EXPECT_TRUE(UI_AdvanceFocus(false, 1, root.get()));
  EXPECT_EQ(manager->GetKeyboardFocusLeafNode(), b.get());
}

TEST(NodeManagerTest, ServicesAndTheSingleton) {
  EXPECT_EQ(UI_NodeManager::Get(false), nullptr);
  EXPECT_THROW(UI_NodeManager::Get(), velkcore::Exception);
  {
    UI_NodeManager manager;
    UI_NodeManager::Set(&manager);
    EXPECT_EQ(UI_NodeManager::GetConst(), &manager);
    // Timer ids of their own stay clear of the ids nodes choose.
    EXPECT_LT(manager.GetUniqueTimerID(), 0);

    std::vector<bool> textEdit;
    manager.InstallTextEditFocusChangedFunction(
        std::make_shared<UI_NodeManager::TextEditFocusChangedFunction>(
            [&](bool focused) { textEdit.push_back(focused); }));
    manager.SetTextEditControlHasFocus(true);
    manager.SetTextEditControlHasFocus(true);
    EXPECT_TRUE(UI_Node::UI_TextEditControlHasFocus());
    EXPECT_EQ(textEdit, std::vector<bool>{true});

    int window = 0;
    int other = 0;
    {
      const SuspendOSMouseActivates suspend(manager, FakeWindow(window));
      EXPECT_TRUE(manager.IsSuspendingOSMouseActivates(FakeWindow(window)));
      EXPECT_FALSE(manager.IsSuspendingOSMouseActivates(FakeWindow(other)));
    }
    EXPECT_FALSE(manager.IsSuspendingOSMouseActivates());
  }
  EXPECT_EQ(UI_NodeManager::Get(false), nullptr);  // a dying manager uninstalls itself
}

}  // namespace
}  // namespace velkui::ui::test
