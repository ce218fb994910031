#pragma once

#include <QPointer>
#include <optional>
#include <utility>

namespace kora {

// A modal window that one routine makes, runs and takes down. It may go with its parent while it
// runs, and as a rule whoever runs it goes then too: nothing of either is to be touched behind a
// Run() that gives nothing.
template <typename Window>
class Modal {
 public:
  template <typename... Arguments>
  explicit Modal(Arguments&&... arguments)
      : window_(new Window(std::forward<Arguments>(arguments)...)) {}
  ~Modal() { delete window_.data(); }
  Modal(const Modal&) = delete;
  Modal& operator=(const Modal&) = delete;

  Window* operator->() const { return window_.data(); }
  Window& operator*() const { return *window_; }
  bool Gone() const { return window_.isNull(); }

  // What its exec() returns; nothing where it went.
  template <typename... Arguments>
  auto Run(Arguments&&... arguments) {
    auto result = window_->exec(std::forward<Arguments>(arguments)...);
    return Gone() ? std::nullopt : std::optional(result);
  }

 private:
  QPointer<Window> window_;
};

}  // namespace kora
