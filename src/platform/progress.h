#pragma once

#include <string_view>

namespace kora {

// What a long pass tells beside its bar. A display shows those that it has room for.
enum class ProgressLine {
  kState,   // what is being done: "Checking no-trades"
  kItem,    // what is in hand: " Updating  BHP"
  kNote,    // what came of it: " Created record for BHP"
  kDate,    // the day that is taken in
  kTarget,  // the folder that is written to
};

// How far a long pass has come, and whether the user wants it to go on. Every pass takes one of
// these, whatever shows it: a form's own bar and labels, a window of its own, a line on standard
// error, nothing. A display of its own (Dialogs::StartProgress) ends when it is destroyed.
//
// All calls are made from the thread that the display lives on. They are cheap enough for every
// record: a display that costs more than that shows some of them only.
class Progress {
 public:
  virtual ~Progress() = default;
  // A pass begins: the bar shows, the pointer is busy, what would start a second one is shut; and
  // back. Calls do not nest. PassOn makes both.
  virtual void SetRunning(bool) {}
  virtual void Show(ProgressLine, std::string_view) {}
  // `done` of `total` steps. Lets the window live meanwhile. False when the user asks to stop; a
  // pass that goes on all the same may be asked again.
  virtual bool Step(int done, int total) = 0;
};

// For passes that nobody watches.
class NoProgress : public Progress {
 public:
  bool Step(int, int) override { return true; }
};

// A pass is shown for as long as this lives, whatever ends it.
class PassOn {
 public:
  explicit PassOn(Progress& progress) : progress_(progress) { progress_.SetRunning(true); }
  ~PassOn() { progress_.SetRunning(false); }
  PassOn(const PassOn&) = delete;
  PassOn& operator=(const PassOn&) = delete;

 private:
  Progress& progress_;
};

}  // namespace kora
