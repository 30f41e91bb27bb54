#include "demo/demo_company.h"

#include <string>
#include <string_view>
#include <system_error>

#include "base/runtime_error.h"
#include "demo/catalogue.h"
#include "demo/companies.h"
#include "demo/connection_store.h"
#include "demo/database_file.h"
#include "demo/sql_files.h"
#include "demo/trade.h"

namespace zebtell::demo {
namespace {

namespace fs = std::filesystem;

struct Range {
    std::string_view name;
    int DemoOptions::*option;
    int lowest;
    int highest;
};
constexpr Range kRanges[] = {
    {"articles", &DemoOptions::articles, 100, 1'000'000},
    {"companies", &DemoOptions::companies, 10, 10'000},
    {"years", &DemoOptions::years, 1, 10},
    {"order rows", &DemoOptions::order_rows, 100, 10'000'000},
};

void CheckRanges(const DemoOptions& options) {
    for (const Range& range : kRanges) {
        const int value = options.*range.option;
        if (value < range.lowest || value > range.highest) {
            throw base::RuntimeError(base::errors::kInvalidCall,
                                     "The number of " + std::string(range.name) + " must be " +
                                         std::to_string(range.lowest) + " to " +
                                         std::to_string(range.highest));
        }
    }
}

void RefuseExisting(const fs::path& file) {
    if (fs::exists(fs::symlink_status(file))) {
        throw base::RuntimeError(base::errors::kInvalidCall,
                                 "The file " + file.string() + " exists already");
    }
}

// The file while it is not complete: removed again unless it gets its name.
class UnfinishedFile {
  public:
    explicit UnfinishedFile(const fs::path& target) : target_(target), path_(target) {
        path_ += ".new";
        RefuseExisting(target_);
        RefuseExisting(path_);
    }
    ~UnfinishedFile() {
        std::error_code ignored;
        fs::remove(path_, ignored);
    }
    UnfinishedFile(const UnfinishedFile&) = delete;
    UnfinishedFile& operator=(const UnfinishedFile&) = delete;

    const fs::path& path() const { return path_; }

    // A second name, since a rename would overwrite what has come there meanwhile. Where files
    // can't have two names a look beforehand must do.
    void Publish() const {
        std::error_code failed;
        fs::create_hard_link(path_, target_, failed);
        if (failed) {
            RefuseExisting(target_);
            fs::rename(path_, target_);
        }
    }

  private:
    fs::path target_;
    fs::path path_;
};

void WriteCompany(CompanyStore& store, const DemoOptions& options) {
    const Catalogue catalogue = WriteCatalogue(store, options.articles);
    const std::vector<Buyer> buyers = WriteCompanies(store, options.companies);
    WriteUsers(store, buyers);
    Trade(store, catalogue, buyers, options).Run();
}

}  // namespace

void MakeDemoCompany(const fs::path& database_file, const DemoOptions& options) {
    CheckRanges(options);
    const UnfinishedFile unfinished(database_file);
    {
        DatabaseFile file(unfinished.path());
        file.Execute(std::string(kSchemaSql));
        file.Execute(std::string(kViewsSql));
        file.PostponeIndexes();
        WriteCompany(file, options);
        file.Finish();
    }
    unfinished.Publish();
}

void MakeDemoCompany(erp::Backend& backend, const DemoOptions& options) {
    CheckRanges(options);
    ConnectionStore store(backend);
    WriteCompany(store, options);
    store.Finish();
}

}  // namespace zebtell::demo
