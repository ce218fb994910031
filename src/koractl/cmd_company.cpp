#include <memory>

#include "base/text.h"
#include "companies/company_grid.h"
#include "koractl/run.h"
#include "koractl/table.h"

namespace kora {
namespace {

CompanyStore OpenStore(Run& run) {
  const DownloadSettings& download = run.session.settings.download;
  if (!KoraDetailsReady(run.session.files, download)) run.Abandon(kNoCompanies, kCompanyTitle);
  try {
    return CompanyStore(run.session.files, download);
  } catch (const RunTimeError& e) {
    run.AbandonFile(e, {.file = "SecurityDetails.Stx"}, kCompanyTitle);
  }
}

int Company(const CommandLine& line, const std::string& code) {
  Run run(line);
  run.Open();
  const CompanyStore store = OpenStore(run);
  if (store.Find(code) == 0)
    run.Abandon("There is no fundamental data for " + UCase(code), UCase(code));
  Table table("Description Value");
  for (const StockDetail& detail : GetStockDetails(store, code))
    table.Text(ToAnsi(detail.description)).Text(ToAnsi(detail.value)).EndRow();
  table.Print();
  return kDone;
}

int Yields(const CommandLine& line, const std::string& industryClass) {
  Run run(line);
  run.Open();
  const CompanyStore store = OpenStore(run);
  std::vector<CompanyRow> rows;
  YieldEnd end;
  try {
    rows = LoadCompanies(store, run.session.files, run.dataPath());
    if (!industryClass.empty())
      std::erase_if(rows, [&](const CompanyRow& row) { return row.IndClass != industryClass; });
    const auto progress = run.dialogs.StartProgress(kCalculatingYields);
    end = CalculateYields(store, run.session.files, run.dataPath(), *progress, rows);
  } catch (const RunTimeError& e) {
    run.AbandonFile(e, {.file = "Names.dat"}, kCompanyTitle);
  }
  if (end.stopped) return kAbandoned;
  if (!end.missing.empty()) run.dialogs.Message(MissingText(end.missing), kCompanyTitle);
  Table table(CompanyHeadings(store));
  for (const CompanyRow& row : rows) {
    for (const std::string& cell : CompanyCells(row)) table.Text(ToAnsi(cell));
    table.EndRow();
  }
  table.Print();
  return kDone;
}

}  // namespace

void AddCompany(CLI::App& app, CommandLine& line) {
  const auto code = std::make_shared<std::string>();
  CLI::App* company = app.add_subcommand("company", "Show the details of a company");
  company->add_option("CODE", *code, "Code of the security, in any case")->required();
  company->callback([&line, code] { line.run = [&line, code] { return Company(line, *code); }; });

  const auto industryClass = std::make_shared<std::string>();
  CLI::App* yields = app.add_subcommand("yields", "Show all companies with prices and yields");
  yields->add_option("--class", *industryClass, "Those of one industry class")
      ->type_name("NNN")
      ->check([](const std::string& text) {
        const bool digits =
            text.size() == 3 && text.find_first_not_of("0123456789") == std::string::npos;
        return digits ? std::string() : "\"" + text + "\" is no class of three digits";
      });
  yields->callback([&line, industryClass] {
    line.run = [&line, industryClass] { return Yields(line, *industryClass); };
  });
}

}  // namespace kora
