#include <unordered_map>
#include <utility>
#include <vector>

#include "base/runtime_error.h"
#include "base/text.h"
#include "markup/node.h"
#include "markup/tag_scan.h"
#include "markup/template.h"

namespace zebtell::markup {
namespace {

// Texts that handlers wrote are kept parsed for the rows that follow, up to this many bytes.
constexpr std::size_t kMemoBytes = 1U << 20U;

struct Name {
    std::string_view name;
    std::string_view lower;
};

// The contents of a tag, as text and as nodes.
struct Block {
    std::string_view contents = {};
    const Node* begin = nullptr;
    const Node* end = nullptr;
};

Block BlockOf(const Node& node) {
    return {node.text, node.ChildrenBegin(), node.ChildrenEnd()};
}

bool IsPlain(const Block& block) {
    return block.begin == block.end ||
           (block.begin + 1 == block.end && block.begin->kind == Node::Kind::kText);
}

// Nodes being written, and what comes after them.
struct Frame {
    const Node* cursor = nullptr;
    Block block = {};
    const Name* next = nullptr;      // then this tag around the same block
    std::string separator = {};      // before it
    const Name* sent_tag = nullptr;  // then this tag's own end
    bool is_piece = false;           // the block is the whole of the last of `pieces_`

    bool IsDone() const { return cursor == block.end && next == nullptr && sent_tag == nullptr; }
};

}  // namespace

// One run through a template, with a stack of its own: neither nested blocks nor rows that follow
// one another take the thread's.
class Expansion {
  public:
    Expansion(const Template& page,
              const std::function<void(Tag&)>& process_tag,
              std::string& out,
              const ExpandLimits& limits)
        : page_(page), process_tag_(process_tag), out_(out), start_(out.size()), limits_(limits) {}

    void Run() {
        Push({.cursor = page_.root().ChildrenBegin(), .block = BlockOf(page_.root())});
        while (!frames_.empty()) WriteFrame();
    }

  private:
    // Writes on until another frame comes before the rest of this one, or this one ends.
    void WriteFrame() {
        Frame& frame = frames_.back();
        while (frame.cursor != frame.block.end) {
            const Node& node = *frame.cursor;
            frame.cursor = node.Next();
            if (node.kind == Node::Kind::kText) {
                out_ += node.text;
            } else if (Raise({node.name, node.lower_name}, BlockOf(node))) {
                return;
            }
        }
        EndFrame(frame);
    }

    void EndFrame(Frame& frame) {
        if (frame.next != nullptr) {
            out_ += frame.separator;
            const Name* next = std::exchange(frame.next, nullptr);
            const Block block = frame.block;
            Raise(*next, block);
            return;
        }
        if (frame.sent_tag != nullptr) out_.append("</").append(frame.sent_tag->name).append(">");
        Pop();
    }

    // Whether the frames have changed.
    bool Raise(const Name& name, const Block& block) {
        CheckLimits(name);
        tag_.name_ = name.name;
        tag_.lower_name_ = name.lower;
        tag_.contents_ = block.contents;
        tag_.output_ = Tag::Output::kContents;
        tag_.SendTags = false;
        process_tag_(tag_);
        const Name* sent_tag = tag_.SendTags ? Kept(name.name) : nullptr;
        if (sent_tag != nullptr) out_.append("<").append(sent_tag->name).append(">");
        if (tag_.output_ == Tag::Output::kText) return WriteText(name, sent_tag);
        return WriteBlock(block, sent_tag);
    }

    bool WriteBlock(const Block& block, const Name* sent_tag) {
        if (tag_.output_ == Tag::Output::kContents && sent_tag == nullptr && IsPlain(block)) {
            out_ += block.contents;
            return false;
        }
        Frame frame{.cursor = block.begin, .block = block, .sent_tag = sent_tag};
        if (tag_.output_ != Tag::Output::kContents) frame.next = Kept(tag_.next_);
        if (tag_.output_ == Tag::Output::kRepeat) frame.separator = tag_.separator_;
        if (tag_.output_ == Tag::Output::kContinue) frame.cursor = block.end;
        if (frame.IsDone()) return false;
        // Finished frames go first, so that row after row takes no more room; but a piece may hold
        // the block itself.
        while (!frames_.empty() && frames_.back().IsDone() && !frames_.back().is_piece) Pop();
        Push(std::move(frame));
        return true;
    }

    bool WriteText(const Name& name, const Name* sent_tag) {
        if (!MayHoldTags(tag_.text_)) {
            out_ += tag_.text_;
            if (sent_tag != nullptr) out_.append("</").append(sent_tag->name).append(">");
            return false;
        }
        std::shared_ptr<const Template> piece = Parsed();
        // The name may lie in a piece that ends here.
        const auto outer = pieces_.empty() ? nullptr : pieces_.back();
        while (!frames_.empty() && frames_.back().IsDone()) Pop();
        if (pieces_.size() >= limits_.depth) Fail(name, "writes tags within tags without end");
        const Block block = BlockOf(piece->root());
        pieces_.push_back(std::move(piece));
        Push({.cursor = block.begin, .block = block, .sent_tag = sent_tag, .is_piece = true});
        return true;
    }

    // The text of the tag; rows often write the same one.
    std::shared_ptr<const Template> Parsed() {
        const auto known = memo_.find(tag_.text_);
        if (known != memo_.end()) return known->second;
        auto piece = Template::Parse({}, std::move(tag_.text_));
        memo_bytes_ += piece->text().size();
        if (memo_bytes_ > kMemoBytes) {
            memo_.clear();
            memo_bytes_ = piece->text().size();
        }
        memo_.emplace(piece->text(), piece);
        return piece;
    }

    // A name that outlives the tag.
    const Name* Kept(std::string_view name) {
        if (last_kept_ != nullptr && last_kept_->name == name) return last_kept_;
        auto found = kept_.find(name);
        if (found == kept_.end()) {
            auto text = std::make_unique<KeptName>();
            text->text = name;
            text->lower = base::Lower(name);
            text->name = {text->text, text->lower};
            const std::string_view key = text->text;
            found = kept_.emplace(key, std::move(text)).first;
        }
        return last_kept_ = &found->second->name;
    }

    void CheckLimits(const Name& name) {
        if (++tags_ > limits_.tags) Fail(name, "repeats itself without end");
        if (out_.size() - start_ > limits_.bytes) Fail(name, "makes the page too long");
    }

    [[noreturn]] void Fail(const Name& name, std::string_view what) const {
        throw base::RuntimeError(base::errors::kInvalidCall,
                                 "Template " + page_.name() + ": the tag " +
                                     std::string(name.name) + " " + std::string(what));
    }

    void Push(Frame frame) { frames_.push_back(std::move(frame)); }

    void Pop() {
        if (frames_.back().is_piece) pieces_.pop_back();
        frames_.pop_back();
    }

    struct KeptName {
        std::string text;
        std::string lower;
        Name name;
    };

    const Template& page_;
    const std::function<void(Tag&)>& process_tag_;
    std::string& out_;
    const std::size_t start_;
    const ExpandLimits limits_;
    Tag tag_;
    std::vector<Frame> frames_;
    std::vector<std::shared_ptr<const Template>> pieces_;  // that frames are writing
    std::unordered_map<std::string_view, std::shared_ptr<const Template>> memo_;
    std::size_t memo_bytes_ = 0;
    std::unordered_map<std::string_view, std::unique_ptr<KeptName>> kept_;
    const Name* last_kept_ = nullptr;
    std::size_t tags_ = 0;
};

void Expand(const Template& page,
            const std::function<void(Tag&)>& process_tag,
            std::string& out,
            const ExpandLimits& limits) {
    Expansion(page, process_tag, out, limits).Run();
}

}  // namespace zebtell::markup
