// Buttons and modal dialogs on real X windows: clicks and keys sent with
// XTest, the hints a window manager reads, the owner blocked while a dialog
// runs, and the pixels the server shows.
//
// A modal run is driven from a second thread with an X connection of its
// own (X11OutsideClient), like a user at another client: while RunModal
// waits in poll(), that input reaches it through the server only. A timer
// of the loop sending the keys itself would put them into the loop's own
// queue and never show that the wait wakes up for input (nor that it waits
// without spinning). The thread touches nothing of the library; what has to
// be checked inside the run is recorded on the main thread by the button
// listeners and read after the run.
#include <pthread.h>
#include <time.h>

#include <algorithm>
#include <atomic>
#include <chrono>
#include <exception>
#include <thread>

#include <velkui/controls/UI_TextButton.h>
#include <velkui/test/MessageLog.h>
#include <velkui/ui/Theme.h>
#include <velkui/ui/UI_Dialog.h>

#include "X11OutsideClient.h"
#include "X11TestSupport.h"

namespace velkui::ui::x11test {
namespace {

using controls::UI_TextButton;
using UI_TextButtonP = boost::intrusive_ptr<UI_TextButton>;

constexpr pictel::ColorRGBA kPaper{0.93f, 0.93f, 0.93f, 1};

using velkui::test::MessageLog;
using Log = std::vector<std::string>;

// A shown button named `name` (in the message log).
UI_TextButtonP AddButton(UI_Node& parent, const std::u16string& text, const RectT<float>& frame,
                         const std::string& name) {
  auto button = velkcore::MakeIntrusive<UI_TextButton>(text);
  button->UI_SetNodeID(name);
  button->UI_SetLocalRectF(frame);
  button->UI_Show(true);
  parent.ChildPushBack(button);
  return button;
}

// ---- Buttons ----

class X11ButtonTest : public X11Test {
 protected:
  X11ButtonTest() {
    window = MakeWindow({120, 120, 400, 160}, kStyleOverlappedWindow);
    background = AddView(*window, {0, 0, 400, 160}, kPaper, "background");
    log.SetPrefixed(true);
    apply = AddButton(*background, u"Apply", {20, 20, 100, 28}, "apply");
    loop = AddButton(*background, u"Loop", {140, 20, 100, 28}, "loop");
    loop->SetSpringLoaded(false);
    log.Watch(*apply);
    log.Watch(*loop);
    PumpFor(0.05);
  }
  // Client coordinates of a point `dx`, `dy` into `button`.
  PointT<std::int32_t> At(const UI_TextButton& button, std::int32_t dx = 50, std::int32_t dy = 14) {
    const RectT<float> r = button.UI_LocalToGlobalF(button.UI_GetLocalRectF(false));
    return Screen(*window, static_cast<std::int32_t>(r.left) + dx,
                  static_cast<std::int32_t>(r.top) + dy);
  }
  bool LogEndsWith(const std::string& entry) {
    return PumpUntil([&] { return !log.Entries().empty() && log.Entries().back() == entry; });
  }

  OS_WindowP window;
  RecordingViewP background;
  UI_TextButtonP apply;
  UI_TextButtonP loop;
  MessageLog log;
};

TEST_F(X11ButtonTest, AClickSendsBeginChangedContinueFinishWithTheModifiersHeld) {
  x11.InjectPointerMove(At(*apply));
  x11.InjectButton(1, true);
  ASSERT_TRUE(LogEndsWith("apply:begin"));
  EXPECT_TRUE(apply->GetDownState()) << "down while pressed";
  EXPECT_EQ(x11.GetCapture(), Handle(*window)) << "the press holds the pointer";
  x11.InjectButton(1, false);
  ASSERT_TRUE(LogEndsWith("apply:finish"));
  EXPECT_EQ(log.Entries(),
            (Log{"apply:begin", "apply:changed(0)", "apply:continue(0)", "apply:finish"}));
  EXPECT_FALSE(apply->GetDownState());
  EXPECT_EQ(x11.GetCapture(), kNoPlatformWindow);

  // Shift held through the click reaches the messages; a toggle flips.
  log.Clear();
  x11.InjectKey(vk::kShift, false, true);
  x11.InjectPointerMove(At(*loop));
  x11.InjectButton(1, true);
  x11.InjectButton(1, false);
  x11.InjectKey(vk::kShift, false, false);
  ASSERT_TRUE(LogEndsWith("loop:finish"));
  EXPECT_EQ(log.Entries(),
            (Log{"loop:begin", "loop:changed(2)", "loop:continue(2)", "loop:finish"}));
  EXPECT_EQ(loop->GetValue(), 1);
  Click(*window, 190, 34);
  ASSERT_TRUE(PumpUntil([&] { return log.Entries().size() == 8; }));
  EXPECT_EQ(loop->GetValue(), 0);
  EXPECT_FALSE(loop->GetDownState());
}

TEST_F(X11ButtonTest, DraggingOffAndBackFollowsThePointerAndAReleaseOutsideTheWindowCancels) {
  x11.InjectPointerMove(At(*apply));
  x11.InjectButton(1, true);
  ASSERT_TRUE(LogEndsWith("apply:begin"));
  // Off the button, still in the window.
  x11.InjectPointerMove(At(*apply, 150, 60));
  ASSERT_TRUE(PumpUntil([&] { return !apply->GetDownState(); }));
  x11.InjectPointerMove(At(*apply, 10, 10));
  ASSERT_TRUE(PumpUntil([&] { return apply->GetDownState(); }));
  // Out of the window altogether: the grab still brings the release.
  const RectT<std::int32_t> client = x11.GetClientRect(Handle(*window));
  x11.InjectPointerMove({client.Right() + 80, client.Bottom() + 80});
  ASSERT_TRUE(PumpUntil([&] { return !apply->GetDownState(); }));
  x11.InjectButton(1, false);
  ASSERT_TRUE(LogEndsWith("apply:cancel"));
  EXPECT_EQ(log.Entries(), (Log{"apply:begin", "apply:cancel"}));
  EXPECT_FALSE(apply->GetDownState());
  EXPECT_EQ(x11.GetCapture(), kNoPlatformWindow);
}

TEST_F(X11ButtonTest, HeldDownTheButtonRepeatsOnTheLoopsTimersAndTheSpaceBarPressesIt) {
  // Interactive listeners make the press repeat (after a quarter second).
  x11.InjectPointerMove(At(*apply));
  x11.InjectButton(1, true);
  ASSERT_TRUE(LogEndsWith("apply:continue(0)"));
  x11.InjectButton(1, false);
  ASSERT_TRUE(LogEndsWith("apply:finish"));
  const auto changed = std::find(log.Entries().begin(), log.Entries().end(), "apply:changed(0)");
  ASSERT_NE(changed, log.Entries().end());
  EXPECT_EQ(log.Entries().front(), "apply:begin");
  EXPECT_EQ(changed + 2, log.Entries().end()) << "no continue of its own after a repeat";
  EXPECT_TRUE(std::all_of(log.Entries().begin() + 1, changed,
                          [](const std::string& e) { return e == "apply:continue(0)"; }));

  log.Clear();
  apply->SetWantsKeyboardFocus(true);
  ASSERT_TRUE(apply->UI_GainKeyboardFocus());
  TypeKey(vk::kSpace);
  ASSERT_TRUE(LogEndsWith("apply:finish"));
  EXPECT_EQ(log.Entries(),
            (Log{"apply:begin", "apply:changed(0)", "apply:continue(0)", "apply:finish"}));
}

// ---- Modal dialogs ----

// A dialog that tells another thread when it has been painted, and closes
// itself after a while so that a run whose input never comes fails instead
// of hanging.
class WatchedDialog : public UI_Dialog {
 public:
  static constexpr std::int32_t kWatchdog = 991;
  using UI_Dialog::UI_Dialog;

  bool UI_Paint(OS_Event* event) const override {
    const bool painted = UI_Dialog::UI_Paint(event);
    if (painted) paints.fetch_add(1);
    return painted;
  }
  bool UI_DoTimerNotify(std::int32_t id) override {
    if (id != kWatchdog) return UI_Dialog::UI_DoTimerNotify(id);
    watchdogFired = true;
    PostClose();
    return true;
  }

  mutable std::atomic<int> paints{0};
  bool watchdogFired = false;
};
using WatchedDialogP = boost::intrusive_ptr<WatchedDialog>;

// The CPU time the main thread has used, readable from another thread.
class ThreadCpuClock {
 public:
  ThreadCpuClock() { pthread_getcpuclockid(pthread_self(), &clock_); }
  double Seconds() const {
    timespec now{};
    clock_gettime(clock_, &now);
    return static_cast<double>(now.tv_sec) + static_cast<double>(now.tv_nsec) * 1e-9;
  }

 private:
  clockid_t clock_{};
};

// What the button listeners saw inside a run.
struct Observed {
  bool ownerEnabled = true;
  bool ownerNodeDisabled = false;
  bool otherEnabled = true;
  bool dialogEnabled = false;
  bool dialogActive = false;
  X11OutsideClient::WindowHints hints;
  Pixel okFace;
  Pixel cancelFace;
};

class X11DialogTest : public X11Test {
 protected:
  X11DialogTest() {
    owner = MakeWindow({80, 80, 720, 480}, kStyleOverlappedWindow);
    ownerView = AddView(*owner, {0, 0, 720, 480}, kPaper, "owner");
    other = MakeWindow({860, 80, 200, 200}, kStyleOverlappedWindow);
    DialogParams params;
    params.title = u"Save changes";
    params.size = {320, 120};
    params.parent = owner.get();
    dialog = velkcore::MakeIntrusive<WatchedDialog>(params);
    log.SetPrefixed(true);
    ok = AddButton(dialog->GetContentContainer(), u"Save", {212, 80, 92, 26}, "ok");
    cancel = AddButton(dialog->GetContentContainer(), u"Cancel", {110, 80, 92, 26}, "cancel");
    dialog->SetButtons(ok, cancel);
    log.Watch(*ok);
    log.Watch(*cancel);
    log.onAdd = [this](const std::string& entry) {
      if (entry.find(":changed") != std::string::npos) Observe();
    };
    owner->UI_Activate();
    PumpFor(0.05);
  }
  ~X11DialogTest() override {
    if (user_.joinable()) user_.join();
  }

  // Runs the dialog modally while `script` plays on a thread of its own once
  // the dialog is painted. Answers the response.
  UI_Dialog::Response RunWhile(std::function<void(X11OutsideClient&)> script) {
    dialog->paints = 0;
    dialog->UI_InstallTimer(10.0f, WatchedDialog::kWatchdog);
    userError_ = nullptr;
    user_ = std::thread([this, script = std::move(script)] {
      try {
        const auto deadline = std::chrono::steady_clock::now() + std::chrono::seconds(5);
        while (dialog->paints.load() == 0 && std::chrono::steady_clock::now() < deadline) {
          std::this_thread::sleep_for(std::chrono::milliseconds(10));
        }
        // Let the first paints settle.
        std::this_thread::sleep_for(std::chrono::milliseconds(150));
        script(outside_);
      } catch (...) {
        userError_ = std::current_exception();
      }
    });
    dialog->RunModal();
    user_.join();
    dialog->UI_RemoveTimer(WatchedDialog::kWatchdog);
    if (userError_) std::rethrow_exception(userError_);
    EXPECT_FALSE(dialog->watchdogFired) << "the input never ended the run";
    // The key releases that came after the close.
    PumpFor(0.1);
    return dialog->GetResponse();
  }
  static void Type(X11OutsideClient& user, std::int16_t key) {
    user.InjectKey(key, false, true);
    user.InjectKey(key, false, false);
  }
  // A point in the middle of `button`'s face, left of its caption.
  Pixel FacePixel(const PixelProbe& probe, const UI_TextButton& button) const {
    const RectT<float> r = button.UI_LocalToGlobalF(button.UI_GetLocalRectF(false));
    return probe.At(static_cast<std::int32_t>(r.left) + 8,
                    static_cast<std::int32_t>(r.top + r.height / 2));
  }
  // Runs in the listener of the button that ends the run, on the main thread.
  void Observe() {
    observed.ownerEnabled = x11.IsWindowEnabled(Handle(*owner));
    observed.ownerNodeDisabled = owner->UI_IsDisabled();
    observed.otherEnabled = x11.IsWindowEnabled(Handle(*other));
    observed.dialogEnabled = x11.IsWindowEnabled(Handle(*dialog));
    observed.dialogActive = x11.GetActiveWindow() == Handle(*dialog);
    observed.hints = hintsReader.ReadHints(Handle(*dialog));
    const PixelProbe probe(*x11.CaptureWindowPixels(Handle(*dialog)));
    observed.okFace = FacePixel(probe, *ok);
    observed.cancelFace = FacePixel(probe, *cancel);
  }

  OS_WindowP owner;
  RecordingViewP ownerView;
  OS_WindowP other;
  WatchedDialogP dialog;
  UI_TextButtonP ok;
  UI_TextButtonP cancel;
  MessageLog log;
  Observed observed;
  X11OutsideClient hintsReader{x11};
  const ThreadCpuClock mainCpu;

 private:
  X11OutsideClient outside_{x11};
  std::thread user_;
  std::exception_ptr userError_;
};

const Log kOkPressed{"ok:begin", "ok:changed(0)", "ok:continue(0)", "ok:finish"};

bool Near(const Pixel& p, const pictel::ColorRGBA& c, int tolerance) {
  const Pixel want = PixelOf(c);
  return std::abs(p.red - want.red) <= tolerance && std::abs(p.green - want.green) <= tolerance &&
         std::abs(p.blue - want.blue) <= tolerance;
}

int Distance(const Pixel& a, const Pixel& b) {
  return std::abs(a.red - b.red) + std::abs(a.green - b.green) + std::abs(a.blue - b.blue);
}

pictel::ColorRGBA Midway(const pictel::ColorRGBA& a, const pictel::ColorRGBA& b) {
  return {(a.red + b.red) / 2, (a.green + b.green) / 2, (a.blue + b.blue) / 2, 1};
}

TEST_F(X11DialogTest, ReturnEndsARealModalRunWithOkWhileTheOwnerIsBlocked) {
  const PointT<std::int32_t> ownerCorner = Screen(*owner, 30, 30);
  double idleCpu = -1;
  const UI_Dialog::Response response = RunWhile([&](X11OutsideClient& user) {
    // The loop waits in poll() between events: it uses no CPU while nothing comes.
    const double before = mainCpu.Seconds();
    std::this_thread::sleep_for(std::chrono::milliseconds(400));
    idleCpu = mainCpu.Seconds() - before;
    // A click on the blocked owner goes nowhere.
    user.InjectPointerMove(ownerCorner);
    user.InjectButton(1, true);
    user.InjectButton(1, false);
    // A window manager may hold the click a moment (to focus the window first).
    std::this_thread::sleep_for(std::chrono::milliseconds(200));
    Type(user, vk::kReturn);
  });
  EXPECT_EQ(response, UI_Dialog::kOk);
  EXPECT_EQ(log.Entries(), kOkPressed) << "Return presses the default button";
  EXPECT_LT(idleCpu, 0.1) << "the modal loop spins";
  EXPECT_TRUE(ownerView->MouseOf(MouseEvent::kButtonDown).empty());

  EXPECT_FALSE(observed.ownerEnabled);
  EXPECT_TRUE(observed.ownerNodeDisabled);
  EXPECT_FALSE(observed.otherEnabled) << "every other library window is blocked";
  EXPECT_TRUE(observed.dialogEnabled);
  EXPECT_TRUE(observed.dialogActive);
  // The default button is drawn as one: the default face, not the plain one.
  const Theme& theme = Theme::Get();
  EXPECT_TRUE(Near(observed.okFace, Midway(theme.GetColor(31), theme.GetColor(32)), 24))
      << "OK face " << observed.okFace;
  EXPECT_TRUE(Near(observed.cancelFace, Midway(theme.GetColor(20), theme.GetColor(21)), 24))
      << "cancel face " << observed.cancelFace;
  EXPECT_GT(Distance(observed.okFace, observed.cancelFace), 90);

  // The run gave everything back.
  EXPECT_TRUE(x11.IsWindowEnabled(Handle(*owner)));
  EXPECT_FALSE(owner->UI_IsDisabled());
  EXPECT_TRUE(x11.IsWindowEnabled(Handle(*other)));
  EXPECT_FALSE(x11.IsWindowVisible(Handle(*dialog)));
  EXPECT_EQ(x11.GetActiveWindow(), Handle(*owner)) << "the window active before";
  // The owner takes clicks again.
  Click(*owner, 30, 30);
  EXPECT_TRUE(PumpUntil([&] { return !ownerView->MouseOf(MouseEvent::kButtonDown).empty(); }));
}

TEST_F(X11DialogTest, TheDialogIsATransientModalWindowOfItsOwnerOnEveryRun) {
  const X11OutsideClient::WindowHints before = hintsReader.ReadHints(Handle(*dialog));
  EXPECT_EQ(before.transientFor, Handle(*owner));
  EXPECT_EQ(before.types, (std::vector<std::string>{"_NET_WM_WINDOW_TYPE_DIALOG"}));
  EXPECT_EQ(before.states, (std::vector<std::string>{"_NET_WM_STATE_MODAL"}));
  EXPECT_TRUE(before.acceptsFocus);
  EXPECT_TRUE(before.closable) << "the close box is shown by default";
  // One application to the window manager: the same group and client leader.
  const X11OutsideClient::WindowHints ownerHints = hintsReader.ReadHints(Handle(*owner));
  EXPECT_NE(before.clientLeader, kNoPlatformWindow);
  EXPECT_EQ(before.group, before.clientLeader);
  EXPECT_EQ(ownerHints.group, before.clientLeader);
  EXPECT_EQ(ownerHints.clientLeader, before.clientLeader);
  EXPECT_NE(std::find(before.protocols.begin(), before.protocols.end(), "WM_DELETE_WINDOW"),
            before.protocols.end());

  EXPECT_EQ(RunWhile([](X11OutsideClient& user) { Type(user, vk::kEscape); }), UI_Dialog::kCancel);
  EXPECT_EQ(log.Entries(),
            (Log{"cancel:begin", "cancel:changed(0)", "cancel:continue(0)", "cancel:finish"}))
      << "Escape presses the cancel button";
  EXPECT_EQ(observed.hints.transientFor, Handle(*owner));
  EXPECT_EQ(observed.hints.states, before.states);
  EXPECT_FALSE(observed.ownerEnabled);

  // A window manager drops the state of a withdrawn window; the next run
  // asks for it again. The response starts as cancel again, and Return ends
  // this run with OK.
  hintsReader.DeleteProperty(Handle(*dialog), "_NET_WM_STATE");
  ASSERT_TRUE(hintsReader.ReadHints(Handle(*dialog)).states.empty());
  log.Clear();
  EXPECT_EQ(RunWhile([](X11OutsideClient& user) { Type(user, vk::kReturn); }), UI_Dialog::kOk);
  EXPECT_EQ(log.Entries(), kOkPressed);
  EXPECT_EQ(observed.hints.states, before.states);
  EXPECT_EQ(observed.hints.types, before.types);
  EXPECT_TRUE(x11.IsWindowEnabled(Handle(*owner)));
}

TEST_F(X11DialogTest, TheBlockedOwnerFocusedByAWindowManagerHandsTheKeysBackToTheDialog) {
  // The run driven by hand, so that the window manager's part can be played
  // in between.
  dialog->BeginModal();
  ASSERT_TRUE(PumpUntil([&] { return dialog->paints.load() > 0; }));
  ASSERT_EQ(x11.GetActiveWindow(), Handle(*dialog));
  hintsReader.FocusWindow(Handle(*owner));
  PumpFor(0.2);
  EXPECT_EQ(x11.GetActiveWindow(), Handle(*dialog));
  TypeKey(vk::kReturn);
  EXPECT_TRUE(PumpUntil([&] { return dialog->IsClosing(); }));
  EXPECT_EQ(log.Entries(), kOkPressed);
  dialog->EndModal();
  EXPECT_EQ(x11.GetActiveWindow(), Handle(*owner));

  // Once it is usable again, the owner takes the focus it is given.
  hintsReader.FocusWindow(Handle(*other));
  EXPECT_TRUE(PumpUntil([&] { return x11.GetActiveWindow() == Handle(*other); }));
}

TEST_F(X11DialogTest, ADialogOfTheDesktopIsNeitherTransientNorModal) {
  DialogParams params;
  params.title = u"About";
  params.size = {200, 100};
  auto lone = velkcore::MakeIntrusive<UI_Dialog>(params);
  const X11OutsideClient::WindowHints hints = hintsReader.ReadHints(Handle(*lone));
  EXPECT_EQ(hints.transientFor, kNoPlatformWindow);
  EXPECT_TRUE(hints.states.empty());
  EXPECT_EQ(hints.types, (std::vector<std::string>{"_NET_WM_WINDOW_TYPE_NORMAL"}));
}

}  // namespace
}  // namespace velkui::ui::x11test
