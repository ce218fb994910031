#pragma once

#include <memory>

class QGuiApplication;

namespace kora {

// What Qt needs to draw pictures, for as long as it lives: an application without a display.
// It costs many times what a script does, and so only pictures make one.
class PictureApp {
 public:
  PictureApp();
  ~PictureApp();
  PictureApp(const PictureApp&) = delete;
  PictureApp& operator=(const PictureApp&) = delete;

 private:
  std::unique_ptr<QGuiApplication> app_;
};

}  // namespace kora
