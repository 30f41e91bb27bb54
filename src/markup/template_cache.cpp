#include "markup/template_cache.h"

#include <atomic>
#include <chrono>
#include <map>
#include <mutex>
#include <shared_mutex>
#include <string>
#include <utility>
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

// A template's name and language.
using Key = std::pair<std::string_view, std::string_view>;
using OwnKey = std::pair<std::string, std::string>;

struct KeyLess {
    using is_transparent = void;
    bool operator()(const Key& a, const Key& b) const { return a < b; }
};

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
    explicit Files(TemplateFolders folders) : folders_(std::move(folders)) {}

    std::shared_ptr<const Template> Get(Key key) {
        const auto entry = Find(key);
        if (entry != nullptr && !(entry->ClaimLook() && entry->HasChanged())) return entry->page;
        return Load(key);
    }

  private:
    std::shared_ptr<Entry> Find(Key key) const {
        const std::shared_lock lock(mutex_);
        const auto found = entries_.find(key);
        return found == entries_.end() ? nullptr : found->second;
    }

    std::shared_ptr<const Template> Load(Key key) {
        const auto [name, language] = key;
        auto entry = std::make_shared<Entry>();
        entry->next_look = NextLook();
        try {
            TemplateText read = ReadTemplate(folders_, name, Catalogue(folders_, language));
            entry->files = std::move(read.files);
            entry->page = Template::Parse(std::string(name), std::move(read.text));
        } catch (...) {
            // What can no longer be read is not shown from memory either.
            const std::unique_lock lock(mutex_);
            if (const auto old = entries_.find(key); old != entries_.end()) entries_.erase(old);
            throw;
        }
        const std::unique_lock lock(mutex_);
        entries_.insert_or_assign({std::string(name), std::string(language)}, entry);
        return entry->page;
    }

    const TemplateFolders folders_;
    mutable std::shared_mutex mutex_;
    std::map<OwnKey, std::shared_ptr<Entry>, KeyLess> entries_;
};

TemplateCache::TemplateCache(TemplateFolders folders)
    : files_(std::make_unique<Files>(std::move(folders))) {}

TemplateCache::~TemplateCache() = default;

std::shared_ptr<const Template> TemplateCache::Get(std::string_view file_name,
                                                   std::string_view language) {
    return files_->Get({file_name, language});
}

}  // namespace zebtell::markup
