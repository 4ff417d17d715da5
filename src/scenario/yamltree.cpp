#include "scenario/yamltree.h"

#include <yaml-cpp/eventhandler.h>
#include <yaml-cpp/exceptions.h>
#include <yaml-cpp/mark.h>
#include <yaml-cpp/parser.h>

#include <algorithm>
#include <set>
#include <sstream>
#include <string_view>

#include "scenario/problems.h"

namespace kdx::scenario {

namespace {

constexpr std::size_t kDeepest = 40;  // nodes within each other; a scenario needs two for a nested step

std::size_t placeOf(const YAML::Mark& mark) {
    return static_cast<std::size_t>(std::max(mark.pos, 0));
}

/// What ends the reading at once, its problem told.
struct Unreadable {};

class TreeBuilder final : public YAML::EventHandler {
public:
    explicit TreeBuilder(Problems& problems) : m_problems(problems) {}

    YamlNode root;
    bool begun = false;

    void OnDocumentStart(const YAML::Mark& mark) override {
        if (begun) refuse(mark, Mistake::SecondScenario);
        begun = true;
    }
    void OnDocumentEnd() override {}

    void OnNull(const YAML::Mark& mark, YAML::anchor_t anchor) override {
        add(made(YamlNode::Kind::Nothing, mark, {}, anchor));
    }
    void OnAlias(const YAML::Mark& mark, YAML::anchor_t /*anchor*/) override { refuse(mark, Mistake::Reference); }
    void OnScalar(const YAML::Mark& mark, const std::string& tag, YAML::anchor_t anchor,
                  const std::string& value) override {
        YamlNode node = made(YamlNode::Kind::Text, mark, tag, anchor);
        node.text = value;
        const std::string_view source = m_problems.text().substr(std::min(node.at, m_problems.text().size()));
        if (tag == "!" && (source.starts_with('"') || source.starts_with('\''))) {
            if (!isClosed(source)) refuse(mark, Mistake::OpenQuote);
            ++node.at;
        }
        add(std::move(node));
    }
    void OnSequenceStart(const YAML::Mark& mark, const std::string& tag, YAML::anchor_t anchor,
                         YAML::EmitterStyle::value /*style*/) override {
        open(YamlNode::Kind::List, mark, tag, anchor);
    }
    void OnSequenceEnd() override { close(); }
    void OnMapStart(const YAML::Mark& mark, const std::string& tag, YAML::anchor_t anchor,
                    YAML::EmitterStyle::value /*style*/) override {
        open(YamlNode::Kind::Map, mark, tag, anchor);
    }
    void OnMapEnd() override { close(); }

private:
    /// A list or map that is being read.
    struct Open {
        YamlNode node;
        std::vector<YamlNode> name = {};  ///< whose value comes next; none or one
        std::set<std::string> names = {};
    };

    [[noreturn]] void refuse(const YAML::Mark& mark, Mistake mistake) {
        m_problems.add(placeOf(mark), mistake);
        throw Unreadable();
    }

    YamlNode made(YamlNode::Kind kind, const YAML::Mark& mark, const std::string& tag, YAML::anchor_t anchor) {
        if (anchor != YAML::NullAnchor) refuse(mark, Mistake::ReferenceName);
        if (!tag.empty() && tag != "?" && tag != "!") refuse(mark, Mistake::Tag);
        YamlNode node;
        node.kind = kind;
        node.at = placeOf(mark);
        return node;
    }

    void open(YamlNode::Kind kind, const YAML::Mark& mark, const std::string& tag, YAML::anchor_t anchor) {
        if (m_open.size() >= kDeepest) refuse(mark, Mistake::TooDeep);
        m_open.push_back({made(kind, mark, tag, anchor)});
    }

    void close() {
        YamlNode node = std::move(m_open.back().node);
        m_open.pop_back();
        add(std::move(node));
    }

    void add(YamlNode node) {
        if (m_open.empty()) {
            root = std::move(node);
            return;
        }
        Open& open = m_open.back();
        if (open.node.kind == YamlNode::Kind::List) {
            open.node.items.push_back(std::move(node));
        } else if (open.name.empty()) {
            lookAtName(open, node);
            open.name.push_back(std::move(node));
        } else {
            if (open.name.back().kind == YamlNode::Kind::Text)
                open.node.members.emplace_back(std::move(open.name.back()), std::move(node));
            open.name.clear();
        }
    }

    void lookAtName(Open& open, const YamlNode& name) {
        if (name.kind != YamlNode::Kind::Text) {
            m_problems.add(name.at, Mistake::NameMissing);
        } else if (!open.names.insert(name.text).second) {
            m_problems.add(name.at, Mistake::Twice, {name.text});
        }
    }

    /// Whether the quoted text that the source begins with has an end: the library takes the end of the file for it.
    static bool isClosed(std::string_view source) {
        const char quote = source.front();
        for (std::size_t i = 1; i < source.size(); ++i) {
            if (source[i] == '\\' && quote == '"') {
                ++i;
            } else if (source[i] == quote) {
                if (quote == '"' || i + 1 >= source.size() || source[i + 1] != quote) return true;
                ++i;
            }
        }
        return false;
    }

    Problems& m_problems;
    std::vector<Open> m_open;
};

}  // namespace

YamlNode readYaml(Problems& problems) {
    addForeignBytes(problems);
    if (!problems.empty()) return {};
    TreeBuilder builder(problems);
    try {
        std::istringstream stream{std::string(problems.text())};
        YAML::Parser parser(stream);
        while (parser.HandleNextDocument(builder)) {
        }
    } catch (const Unreadable&) {  // told where it was found
    } catch (const YAML::ParserException& error) {
        problems.add(placeOf(error.mark), Mistake::NoYaml, {error.msg});
    }
    return std::move(builder.root);
}

}  // namespace kdx::scenario
