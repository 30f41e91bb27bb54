#include "markup/template_cache.h"

#include <atomic>
#include <chrono>
#include <map>
#include <mutex>
#include <shared_mutex>
#include <string>
#include <vector>

#include "markup/template_files.h"

namespace zebtell::markup {
namespace {

using Ticks = std::chrono::steady_clock::rep;

constexpr auto kBetweenLooks = std::chrono::seconds(1);

Ticks Now() {
    return std::chrono::steady_clock::now().time_since_epoch().count();
}

Ticks NextLook() {
    return Now() + std::chrono::steady_clock::duration(kBetweenLooks).count();
}

struct Entry {
    std::shared_ptr<const Template> page;
    std::vector<FileStamp> files;
    std::atomic<Ticks> next_look;

    bool HasChanged() const {
        for (const FileStamp& file : files)
            if (FileStamp::Of(file.path) != file) return true;
        return false;
    }
    // True for one caller each time that a look at the files is due.
    bool ClaimLook() {
        Ticks due = next_look.load(std::memory_order_relaxed);
        return Now() >= due && next_look.compare_exchange_strong(due, NextLook());
    }
};

}  // namespace

class TemplateCache::Files {
  public:
    explicit Files(std::filesystem::path folder) : folder_(std::move(folder)) {}

    std::shared_ptr<const Template> Get(std::string_view name) {
        const auto entry = Find(name);
        if (entry != nullptr && !(entry->ClaimLook() && entry->HasChanged())) return entry->page;
        return Load(name);
    }

  private:
    std::shared_ptr<Entry> Find(std::string_view name) const {
        const std::shared_lock lock(mutex_);
        const auto found = entries_.find(name);
        return found == entries_.end() ? nullptr : found->second;
    }

    std::shared_ptr<const Template> Load(std::string_view name) {
        auto entry = std::make_shared<Entry>();
        entry->next_look = NextLook();
        try {
            TemplateText read = ReadTemplate(folder_, name);
            entry->files = std::move(read.files);
            entry->page = Template::Parse(std::string(name), std::move(read.text));
        } catch (...) {
            // What can no longer be read is not shown from memory either.
            const std::unique_lock lock(mutex_);
            if (const auto old = entries_.find(name); old != entries_.end()) entries_.erase(old);
            throw;
        }
        const std::unique_lock lock(mutex_);
        entries_.insert_or_assign(std::string(name), entry);
        return entry->page;
    }

    const std::filesystem::path folder_;
    mutable std::shared_mutex mutex_;
    std::map<std::string, std::shared_ptr<Entry>, std::less<>> entries_;
};

TemplateCache::TemplateCache(std::filesystem::path folder)
    : files_(std::make_unique<Files>(std::move(folder))) {}

TemplateCache::~TemplateCache() = default;

std::shared_ptr<const Template> TemplateCache::Get(std::string_view file_name) {
    return files_->Get(file_name);
}

}  // namespace zebtell::markup
