#pragma once

#include <QDialog>
#include <functional>

#include "looks/colours.h"
#include "platform/dialogs.h"

namespace kora {

class ColourItem;

struct ColNewServices {
  const Files& files;
  const std::string& systemPath;
  Dialogs& dialogs;
  ChartColours& colours;         // changed at once by every click
  std::function<void()> closed;  // the chart is drawn anew; may be empty
};

// "Change Chart Colours": a colour is clicked, then the items that are to have it.
class ColNew : public QDialog {
 public:
  ColNew(ColNewServices services, QWidget* parent);

  // Leaving without a save takes back the user's file.
  void reject() override;

 private:
  static constexpr int kSwatches = 16, kItems = 35;
  // Entry of the table that item `index` shows: Background comes first.
  static int EntryOf(int index);
  void Give(int index);
  void ShowColours();
  void LoadVariant(const char* variant);
  void Save();
  void Left();

  ColNewServices services_;
  int chosen_ = 0;  // swatch
  ColourItem* label1_[kSwatches];
  ColourItem* label2_[kItems];
};

}  // namespace kora
