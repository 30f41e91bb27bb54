#include "check/page_walk.h"

#include <algorithm>
#include <array>

#include "base/text.h"
#include "check/addresses.h"
#include "check/field_check.h"
#include "check/statement_check.h"
#include "check/tag_contents.h"
#include "markup/node.h"
#include "tags/custom_func.h"
#include "tags/page_tags.h"

namespace zebtell::check {
namespace {

using markup::Node;

constexpr std::string_view kPrefix = "zeb:";
constexpr std::string_view kRowEnd = ".row";
constexpr std::string_view kAnyTable = "*";
constexpr std::array<std::string_view, 3> kAddresses = {"href", "action", "formaction"};

class PageWalk {
  public:
    PageWalk(PageReading& reading, std::span<const CheckedPage> pages)
        : reading_(reading),
          pages_(pages),
          tree_(markup::ParseNodes(reading.source.text)),
          html_([this](const HtmlReader::Attribute& attribute) { CheckAddress(attribute); }) {}

    void Run() {
        FindQueries();
        for (std::string_view stray : tree_.strays) {
            reading_.Report(stray, std::string(stray) + " has no start before it");
        }
        const Node& root = tree_.nodes.front();
        Read(root, root.text);
    }

  private:
    // The nodes inside of `node` as far as they lie in `part` of its contents.
    void Read(const Node& node, std::string_view part) {
        const char* end = part.data() + part.size();
        for (const Node* child = node.ChildrenBegin(); child != node.ChildrenEnd();
             child = child->Next()) {
            const bool is_text = child->kind == Node::Kind::kText;
            const std::string_view where = is_text ? child->text : child->name;
            const char* from = std::max(where.data(), part.data());
            const char* to = std::min(where.data() + where.size(), end);
            if (from >= to) continue;
            if (is_text) {
                html_.Read({from, static_cast<std::size_t>(to - from)});
            } else {
                ReadTag(*child);
            }
        }
    }

    void ReadTag(const Node& node) {
        if (!node.is_complete) {
            reading_.Report(node.name, std::string(node.name) + " has no end");
        }
        CheckIsKnown(node);
        if (node.lower_name == "zeb:text" && node.is_complete) {
            reading_.Report(node.name, "ZEB:Text is empty, in another, or around an include");
        }
        const TagText tag{node.name, node.lower_name, node.text};
        const TagContents* known = FindTagContents(reading_.page.name, node.lower_name);
        if (known == nullptr && IsQueryField(node)) {
            ReadReference(node, {.name = node.name, .table = node.name.substr(kPrefix.size())});
        } else if (known == nullptr) {
            ReadTemplateText(node);
        } else if (!known->table.empty()) {
            const std::string_view table = known->table == kAnyTable ? "" : known->table;
            ReadReference(node, {node.name, table, known->own_words});
        } else {
            if (known->check != nullptr) known->check(reading_, tag);
            html_.ReadGap();
        }
    }

    void ReadTemplateText(const Node& node) {
        if (node.text.empty()) return html_.ReadGap();
        Read(node, node.text);
    }

    void ReadReference(const Node& node, const FieldTag& tag) {
        CheckReference(reading_, tag, node.text, html_.place());
        const auto outputs = ConditionOutputs(node.text);
        for (std::string_view output : outputs) Read(node, output);
        if (outputs.empty()) html_.ReadGap();
    }

    void FindQueries() {
        for (const Node& node : tree_.nodes) {
            if (node.lower_name != "zeb:query") continue;
            const std::string_view name = node.text.substr(0, node.text.find(';'));
            reading_.queries.push_back(tags::CleanFormValue(name));
        }
    }

    const tags::TagRow* FindTag(std::string_view lower_name) const {
        const tags::TagTable* own = reading_.page.own_tags;
        for (const auto* table : {&tags::CommonTagTable(), &tags::OrderSummaryTagTable(), own}) {
            const auto* row = table == nullptr ? nullptr : table->Find(lower_name);
            if (row != nullptr) return row;
        }
        return nullptr;
    }

    bool IsQueryField(const Node& node) const {
        return FindTag(node.lower_name) == nullptr &&
               DefinesQuery(reading_, node.name.substr(kPrefix.size()));
    }

    void CheckIsKnown(const Node& node) {
        const std::string_view name = node.name.substr(kPrefix.size());
        if (node.lower_name.ends_with(kRowEnd)) {
            const std::string query(name.substr(0, name.size() - kRowEnd.size()));
            if (DefinesQuery(reading_, query)) return;
            reading_.Report(node.name,
                            std::string(node.name) + ": the page defines no query " + query);
        } else if (FindTag(node.lower_name) == nullptr && !DefinesQuery(reading_, name)) {
            reading_.Report(node.name, "unknown tag " + std::string(node.name));
        }
    }

    void CheckAddress(const HtmlReader::Attribute& attribute) {
        if (std::find(kAddresses.begin(), kAddresses.end(), attribute.name) == kAddresses.end()) {
            return;
        }
        if (const auto fault = AddressFault(attribute.value, pages_)) {
            reading_.Report(attribute.begins, *fault);
        }
    }

    PageReading& reading_;
    std::span<const CheckedPage> pages_;
    const markup::NodeTree tree_;
    HtmlReader html_;
};

}  // namespace

void WalkPage(PageReading& reading, std::span<const CheckedPage> pages) {
    PageWalk(reading, pages).Run();
}

}  // namespace zebtell::check
