#pragma once

#include <QDialog>
#include <array>
#include <functional>
#include <optional>

#include "shell/session.h"

class QLineEdit;
class QRadioButton;
class QToolButton;

namespace kora {

struct FirstStartServices {
  Session& session;
  // Makes the invented market in the home; false when the user stopped it.
  std::function<bool()> makeDemo;
  // Asks for a folder of the host; empty for the platform's own dialog.
  std::function<std::optional<QString>()> pickFolder = {};
};

// The question of a start without an installation: the invented market, an empty one, or a folder
// of data that is there. Accepted, the home is an installation.
class FirstStart : public QDialog {
 public:
  explicit FirstStart(FirstStartServices services, QWidget* parent = nullptr);

 private:
  void Choose();
  bool Make();
  bool OpenFolder();
  void PickFolder();
  void ShowChoice();

  FirstStartServices services_;
  std::array<QRadioButton*, 3> option1_{};
  QLineEdit* text1_;
  QToolButton* picture1_;
};

// True where nothing says where the data lies: there is no settings file.
bool NeedsFirstStart(const Session& session);

}  // namespace kora
