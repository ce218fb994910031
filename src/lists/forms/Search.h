#pragma once

#include <QDialog>
#include <cstdint>
#include <optional>
#include <vector>

#include "lists/name_search.h"

class QLineEdit;
class QListWidget;

namespace kora {

class Dialogs;

// Finds a security by a part of its name: the matches stand in a list, the first one chosen.
class Search : public QDialog {
 public:
  Search(const Files& files, Dialogs& dialogs, const std::string& dataPath, const std::string& text,
         QWidget* parent);

  // The match that was selected; nothing when there were no more.
  std::optional<NameMatch> match() const;

 private:
  void ShowMatch();
  void FindNext();

  std::vector<NameMatch> matches_;
  int chosen_ = 0;  // the number of matches: behind the last one
  QLineEdit* text1_[2];
  QListWidget* list1_;
};

}  // namespace kora
