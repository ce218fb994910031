#pragma once

#include <QDialog>
#include <cstdint>
#include <optional>

#include "lists/name_search.h"

class QLineEdit;

namespace kora {

class Dialogs;

// Finds a security by a part of its name.
class Search : public QDialog {
 public:
  Search(const Files& files, Dialogs& dialogs, const std::string& dataPath,
         const std::string& text, QWidget* parent);

  // The match that was selected; nothing when there were no more.
  const std::optional<NameMatch>& match() const { return match_; }

 private:
  void FindNext();

  Dialogs& dialogs_;
  NameSearch search_;
  std::optional<NameMatch> match_;
  QLineEdit* text1_[2];
};

}  // namespace kora
