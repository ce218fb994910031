#pragma once

#include <memory>
#include <optional>
#include <string>

#include "adjust/adjust_date.h"
#include "adjust/adjustment.h"
#include "adjust/issue_figures.h"
#include "platform/dialogs.h"

// An adjustment entered by hand, without its form: figures and date checked, the record looked up,
// the file adjusted. For one thread.

namespace kora {

inline constexpr std::string_view kAdjustTitle = "Adjust Data";
inline constexpr std::string_view kDateFormatTitle = "Incorrect Date Format ";
inline constexpr std::string_view kAdjustedTitle = "Data Adjustments";
inline constexpr std::string_view kRemoveTitle = "Remove Adjustments";

struct AdjustServices {
  const Files& files;
  Dialogs& dialogs;
  std::string dataPath;       // folder of the price files
  std::string ChartMiscPath;  // of the chart notes
  std::int32_t NoteColour;    // ChartColours(26)
};

class IssueAdjustment {
 public:
  IssueAdjustment(AdjustServices services, IssueKind kind)
      : services_(std::move(services)), kind_(kind) {}

  IssueKind kind() const { return kind_; }

  // Checks figures and date and looks up the record of the date in the price file of `code`.
  // `typedForMessages` is the date as it is told, where that is not the one typed. False after a
  // message; the look-up before is forgotten. Where the nearest date is another, it is told too.
  bool CheckDate(const std::string& code, const IssueFigures& figures, const std::string& typed,
                 const std::string& typedForMessages);
  // The records to choose from; empty before a look-up.
  const AdjustmentDates& dates() const { return dates_; }
  // The date typed as "d/m/yy"; of a line of the list.
  const std::string& date() const { return date_; }
  std::string DateOfLine(size_t line) const;
  void Forget();

  // Works out factor and note from the record `AdjRecNo`, shows the note by `show`, and adjusts
  // the file. True once it is done and told; false after a message, with nothing changed.
  bool Adjust(const IssueFigures& figures, std::int16_t AdjRecNo,
              const std::function<void(const std::string& desc)>& show);

 private:
  void Refuse(std::string_view text, std::string_view title = kAdjustTitle);

  AdjustServices services_;
  IssueKind kind_;
  std::string code_, date_;
  std::unique_ptr<PriceEdit> file_;
  AdjustmentDates dates_;
};

enum class RemoveEnd { kRemoved, kNone, kFailed };
// Takes out the latest adjustment and tells it, asking whether to go on with the next one while
// there are more; `times` set, that many without asking. kNone: told that there was none at all.
RemoveEnd RemoveAdjustments(const AdjustServices& services, const std::string& code,
                            std::optional<int> times = {});

}  // namespace kora
