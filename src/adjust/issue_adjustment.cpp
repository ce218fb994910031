#include "adjust/issue_adjustment.h"

#include <new>

#include "base/dates.h"
#include "base/runtime_error.h"
#include "base/text.h"

namespace kora {
namespace {

std::string PriceFileOf(const AdjustServices& services, const std::string& code) {
  return services.dataPath + CodeFileName(Trim(code), ".WDT");
}

// The one place where a failure of the work is told.
template <typename Work>
bool Told(Dialogs& dialogs, std::string_view title, Work work) {
  try {
    return work();
  } catch (const RunTimeError& e) {
    dialogs.Message(e.what(), title);
  } catch (const std::bad_alloc&) {
    dialogs.Message(ErrorText(kOutOfMemory), title);
  }
  return false;
}

}  // namespace

void IssueAdjustment::Refuse(std::string_view text, std::string_view title) {
  services_.dialogs.Message(text, title);
}

void IssueAdjustment::Forget() {
  dates_ = {};
  file_.reset();
  date_.clear();
}

bool IssueAdjustment::CheckDate(const std::string& code, const IssueFigures& figures,
                                const std::string& typed, const std::string& typedForMessages) {
  Forget();
  if (const auto fault = FiguresFault(kind_, figures, true); !fault.empty()) {
    Refuse(fault);
    return false;
  }
  if (Trim(typed).empty()) {
    Refuse(" Date must be entered");
    return false;
  }
  const auto wanted = AdjWantedDateOf(typed);
  if (!wanted) {
    Refuse(kDateFormat, kDateFormatTitle);
    return false;
  }
  return Told(services_.dialogs, kAdjustTitle, [&] {
    auto file = std::make_unique<PriceEdit>(services_.files, PriceFileOf(services_, code));
    AdjustmentDates dates = FindAdjustmentDate(file->records(), *wanted);
    if (dates.empty()) {
      Refuse("No close price on file for " + typedForMessages);
      return false;
    }
    code_ = Trim(code);
    date_ = FormatUserDate(*ParseFileDate(*wanted));
    dates_ = std::move(dates);
    file_ = std::move(file);
    const std::string other = OtherDateText(file_->records(), dates_, *wanted, typedForMessages);
    if (!other.empty()) Refuse(other);
    return true;
  });
}

std::string IssueAdjustment::DateOfLine(size_t line) const {
  const auto date = ParseFileDate(DateToFile(dates_.Lines.at(line).substr(0, 10)));
  return date ? FormatUserDate(*date) : std::string();
}

bool IssueAdjustment::Adjust(const IssueFigures& figures, std::int16_t AdjRecNo,
                             const std::function<void(const std::string&)>& show) {
  if (!file_) return false;
  if (const auto fault = FiguresFault(kind_, figures, false); !fault.empty()) {
    Refuse(fault);
    return false;
  }
  return Told(services_.dialogs, kAdjustTitle, [&] {
    if (AdjRecNo < 1 || size_t(AdjRecNo) > file_->records().size())
      throw RunTimeError(kBadRecordNumber);
    const float AdjClose = file_->records()[size_t(AdjRecNo - 1)].Close;
    const Adjustment adjustment = FigureAdjustment(kind_, figures, AdjClose);
    if (show) show(adjustment.AdjDescText);
    const AdjustedSecurity security{services_.files, file_->path(),
                                    ChartNotesPath(services_.ChartMiscPath, code_),
                                    services_.NoteColour};
    PriceEdit edit = *file_;  // what was chosen from stays as it was should this fail
    ApplyAdjustment(security, edit, AdjRecNo, adjustment);
    Refuse("Adjustments made to\n" + code_, kAdjustedTitle);
    Forget();
    return true;
  });
}

RemoveEnd RemoveAdjustments(const AdjustServices& services, const std::string& code,
                            std::optional<int> times) {
  constexpr std::string_view kRemovedTitle = "Remove Adjustment";
  RemoveEnd end = RemoveEnd::kNone;
  const bool well = Told(services.dialogs, kRemoveTitle, [&] {
    const std::string path = PriceFileOf(services, code);
    const std::string removed = "Latest adjustment removed for " + std::string(Trim(code));
    for (int left = times.value_or(0);;) {
      const int stamps = RemoveAdjustment(services.files, path);
      if (stamps == 0) {
        if (end == RemoveEnd::kNone)
          services.dialogs.Message("File has not previously been adjusted", kRemoveTitle);
        return true;
      }
      end = RemoveEnd::kRemoved;
      if (times || stamps == 1) {
        services.dialogs.Message(removed, kRemovedTitle);
        if (stamps == 1 || --left == 0) return true;
      } else if (services.dialogs.Ask(removed + "\nRemove next adjustment ?", kRemovedTitle,
                                      Buttons::kYesNo) != Answer::kYes) {
        return true;
      }
    }
  });
  return well ? end : RemoveEnd::kFailed;
}

}  // namespace kora
