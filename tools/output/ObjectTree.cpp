// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/output/ObjectTree.h"

#include "host/broker/ObjectPath.h"
#include "tools/cim/ObjectNames.h"
#include "tools/output/Emphasis.h"
#include "tools/output/PrintableText.h"

#include <algorithm>
#include <string>
#include <vector>

namespace Tools {

namespace {

using Index = AssociationGraph::Index;
using Link = AssociationGraph::Link;

// The prefixes of an object's line and of the lines below it, all of the same width.
struct Branch {
    const char* object;
    const char* below;
};

constexpr Branch utf8Branch = {"├─ ", "│  "};
constexpr Branch utf8LastBranch = {"└─ ", "   "};
constexpr Branch asciiBranch = {"|- ", "|  "};
constexpr Branch asciiLastBranch = {"`- ", "   "};

class TreeWriter {
public:
    TreeWriter(Output& out, const AssociationGraph& graph, Index root, const TextStyle& style)
        : out_(out), graph_(graph), style_(style), distances_(graph.distancesFrom(root)),
          isDescended_(distances_.size(), false)
    {
        const Host::ObjectPath& path = graph.path(root);
        writeLine("", shortName(path), " (" + std::string(path.className()) + ")");
        writeBelow(root, "");
    }

private:
    // Returns whether the tree shows the link below the object: links towards the root are left
    // out.
    bool isShown(Index object, const Link& link) const
    {
        return link.target != object && distances_[link.target] >= distances_[object];
    }

    std::vector<const Link*> shownLinks(Index object) const
    {
        std::vector<const Link*> shown;
        for (const Link& link : graph_.links(object))
            if (isShown(object, link))
                shown.push_back(&link);
        return shown;
    }

    // Returns whether the linked objects are at least two and the same is below each of them.
    bool isSameBelow(Index object, const std::vector<const Link*>& links) const
    {
        if (links.size() < 2)
            return false;
        const std::vector<const Link*> first = shownLinks(links.front()->target);
        return !first.empty() && std::all_of(links.begin(), links.end(), [&](const Link* link) {
            const std::vector<const Link*> below = shownLinks(link->target);
            return link->role == links.front()->role && !isDescended_[link->target] &&
                   distances_[link->target] > distances_[object] &&
                   std::equal(below.begin(), below.end(), first.begin(), first.end(),
                       [](const Link* one, const Link* other) { return *one == *other; });
        });
    }

    // Returns the link of an object by which a link to it leads back.
    const Link& linkBack(Index from, const Link& link) const
    {
        const std::vector<Link>& links = graph_.links(link.target);
        return *std::find_if(links.begin(), links.end(), [&](const Link& each) {
            return each.target == from && each.associationClass == link.associationClass;
        });
    }

    // Removes the links to siblings of the object to which a link leads back: the objects with its
    // role in the same association, below which nothing is shown. Keeps a single one. Returns how
    // many it removed.
    std::size_t removeSiblings(std::vector<const Link*>& links, const Link& back) const
    {
        std::vector<const Link*> others = links;
        const std::size_t removed = std::erase_if(others, [&](const Link* link) {
            return link->role == back.role && link->associationClass == back.associationClass &&
                   shownLinks(link->target).empty();
        });
        if (removed < 2)
            return 0;
        links = std::move(others);
        return removed;
    }

    // Leaves out the siblings of the object to which a link leads back. The recursion ends despite
    // cycles, since each step increases the distance from the root.
    void writeBelow(Index object, const std::string& indent, const Link* back = nullptr)
    {
        isDescended_[object] = true;
        std::vector<const Link*> links = shownLinks(object);
        const std::size_t siblings = back == nullptr ? 0 : removeSiblings(links, *back);
        if (siblings > 0)
            writeLine(indent + branchOf(links.empty()).object,
                back->role + " " + std::to_string(siblings) + " others", remarkOf(*back));
        const bool isFolded = isSameBelow(object, links);
        for (std::size_t i = 0; i < links.size(); ++i) {
            const Branch& branch = branchOf(i + 1 == links.size() && !isFolded);
            if (isFolded)
                writeLine(indent + branch.object, nameOf(*links[i]), remarkOf(*links[i]));
            else
                writeLink(object, *links[i], indent + branch.object, indent + branch.below);
        }
        if (isFolded)
            writeFolded(links, indent);
    }

    // Writes what is below each of the linked objects once.
    void writeFolded(const std::vector<const Link*>& links, const std::string& indent)
    {
        for (const Link* const link : links)
            isDescended_[link->target] = true;
        const Index first = links.front()->target;
        const std::vector<const Link*> below = shownLinks(first);
        for (std::size_t i = 0; i < below.size(); ++i) {
            const Branch& branch = branchOf(i + 1 == below.size());
            writeLink(first, *below[i], indent + branch.object, indent + branch.below,
                "each " + links.front()->role + ": ");
        }
    }

    std::string nameOf(const Link& link) const
    {
        return link.role + " " + shortName(graph_.path(link.target));
    }

    static std::string remarkOf(const Link& link) { return " (" + link.associationClass + ")"; }

    void writeLink(Index object, const Link& link, const std::string& before,
        const std::string& indentBelow, const std::string& whose = "")
    {
        const bool leadsAway = distances_[link.target] > distances_[object];
        const bool isRepeated = isDescended_[link.target];
        const bool hidesSome = (isRepeated || !leadsAway) && !shownLinks(link.target).empty();
        writeLine(before + whose, nameOf(link), remarkOf(link) + (hidesSome ? " ..." : ""));
        if (leadsAway && !isRepeated)
            writeBelow(link.target, indentBelow, &linkBack(object, link));
    }

    const Branch& branchOf(bool isLast) const
    {
        if (style_.isUtf8)
            return isLast ? utf8LastBranch : utf8Branch;
        return isLast ? asciiLastBranch : asciiBranch;
    }

    // Shortens the remark first when the line is too long.
    void writeLine(const std::string& before, const std::string& object, const std::string& remark)
    {
        const std::string text = before + printable(object, style_.isUtf8);
        const std::string shown = fitting(text, style_.width);
        const std::size_t used = displayWidth(shown);
        const std::size_t room = style_.width > used ? style_.width - used : 0;
        const std::string rest = room == 0 ? "" : fitting(printable(remark, style_.isUtf8), room);
        out_.write(shown + emphasized(rest, Emphasis::faint, style_.isColored) + "\n");
    }

    std::string fitting(const std::string& text, std::size_t width) const
    {
        return displayWidth(text) <= width ? text : cutToWidth(text, width, style_.isUtf8);
    }

    Output& out_;
    const AssociationGraph& graph_;
    const TextStyle& style_;
    std::vector<std::size_t> distances_;
    std::vector<bool> isDescended_;
};

} // namespace

void writeTree(Output& out, const AssociationGraph& graph, AssociationGraph::Index root,
    const TextStyle& style)
{
    TreeWriter(out, graph, root, style);
}

} // namespace Tools
