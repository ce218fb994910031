#include "chart/chart_failure.h"

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "store/name_rec.h"

namespace kora {

std::string DateForMessage(const PriceFile& file, std::int16_t record) {
  if (record == 0) return {};
  try {
    return FromAnsi(file.Read(record).RecDate.trimmed());
  } catch (const RunTimeError&) {
    return {};  // the first failure is the one to tell
  }
}

std::string ChartFailureText(int number, const std::string& detail, const ChartFailure& at) {
  const std::string record = Str(std::int32_t(at.record));
  switch (number) {
    case 0:
    case kBadCall:
    case kOverflow: {
      std::string text = "There is a problem with the data for " + at.file + "\n";
      // A failure that no record stands behind tells itself.
      if (at.record == 0 && at.date.empty() && detail != ErrorText(number))
        return text + " " + detail;
      if (at.record != 0)
        text += " at Rec Number (" + record + ") " + at.date;
      else
        text += " at date (" + at.date + ") ";
      text += at.RecType == kAdvanceDecline
                  ? "\nUse Check advance/decline totals procedure to adjust base to a higher "
                    "positive number."
                  : "\nUse View/Modify Data procedure to correct.";
      return text;
    }
    case kOutOfMemory:
    case kOutOfTextSpace:
    case kOutOfStack:
      return "There appears to be a memory problem\nOut of memory\nExit Windows then retry";
    case kBadFileName:
    case kFileNotFound:
    case kBadRecordNumber:
    case kPathAccess:
    case kPathNotFound: return "There is a problem with " + at.file + " Cannot find or open";
    case kInvalidValue:
      if (const std::string font = UCase(at.font); !font.empty())
        return "There is a problem with the Font you have selected for " + font +
               ". Select another Font and try again - Try MS Sans Serif or MS Serif if available";
      return "There is a possibly a problem with a Font you have selected. Select another Font "
             "and try again - Try MS Sans Serif or Arial if available";
    case kNoPicture:
      return "There is not enough memory to complete all pages display. Please ring KORA if this "
             "message appears often.";
    default: {
      std::string text =
          "There is an unexpected error No. " + Str(std::int32_t(number)) + "\n" + detail;
      if (at.record != 0)
        text +=
            " Check data at Record number " + record + " using View/Modify to check and correct.";
      return text;
    }
  }
}

}  // namespace kora
