// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/output/ObjectTree.h"

#include "host/broker/Broker.h"
#include "host/broker/Instance.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/Request.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/tools/ToolTest.h"

#include <fcntl.h>
#include <unistd.h>

namespace {

class ObjectTreeTest : public testing::Test {
protected:
    Host::ObjectPath& object(const char* name)
    {
        Host::ObjectPath& path = request_.makePath("root/cimv2", "Object");
        path.addKey("Name", Host::Value::text(request_.arena(), name));
        return path;
    }

    void link(const char* upper, const char* lower)
    {
        Host::Instance& association =
            request_.makeInstance(request_.makePath("root/cimv2", "Link"));
        association.setProperty("Up", Host::Value::of(object(upper)));
        association.setProperty("Down", Host::Value::of(object(lower)));
        graph_.add(association);
    }

    std::string tree(const char* root, std::size_t width = 80, bool isUtf8 = false)
    {
        const std::string file = (folder_.path() / "tree").string();
        const int descriptor = ::open(file.c_str(), O_WRONLY | O_CREAT | O_TRUNC, 0600);
        Tools::Output out(descriptor);
        Tools::writeTree(out, graph_, graph_.indexOf(object(root)), {width, false, isUtf8});
        out.flush();
        ::close(descriptor);
        return Testing::contentOf(file);
    }

    Testing::TemporaryFolder folder_;
    Host::Broker broker_;
    Host::Request request_{broker_};
    Tools::AssociationGraph graph_;
};

TEST_F(ObjectTreeTest, AnObjectWithoutAssociationsStandsAlone)
{
    EXPECT_EQ(tree("a"), "a (Object)\n");
}

TEST_F(ObjectTreeTest, BranchesEndWhereTheirLastObjectStands)
{
    link("a", "b");
    link("b", "c");
    link("b", "d");
    link("a", "e");
    EXPECT_EQ(tree("a", 80, true), "a (Object)\n"
                                   "├─ Down b (Link)\n"
                                   "│  ├─ Down c (Link)\n"
                                   "│  └─ Down d (Link)\n"
                                   "└─ Down e (Link)\n");
    EXPECT_EQ(tree("c"), "c (Object)\n"
                         "`- Up b (Link)\n"
                         "   |- Up a (Link)\n"
                         "   |  `- Down e (Link)\n"
                         "   `- Down d (Link)\n");
}

TEST_F(ObjectTreeTest, AnObjectIsDescendedOnceAndNamedWhereItComesAgain)
{
    link("a", "b");
    link("a", "c");
    link("b", "d");
    link("c", "d");
    link("d", "e");
    link("c", "f");
    EXPECT_EQ(tree("a"), "a (Object)\n"
                         "|- Down b (Link)\n"
                         "|  `- Down d (Link)\n"
                         "|     `- Down e (Link)\n"
                         "`- Down c (Link)\n"
                         "   |- Down d (Link) ...\n"
                         "   `- Down f (Link)\n");
}

TEST_F(ObjectTreeTest, WhatIsTheSameBelowSeveralObjectsIsWrittenOnce)
{
    link("a", "b");
    link("a", "c");
    link("b", "d");
    link("c", "d");
    link("d", "e");
    EXPECT_EQ(tree("a"), "a (Object)\n"
                         "|- Down b (Link)\n"
                         "|- Down c (Link)\n"
                         "`- each Down: Down d (Link)\n"
                         "   `- Down e (Link)\n");
}

TEST_F(ObjectTreeTest, SiblingsAreCounted)
{
    link("a", "b");
    for (const char* const sibling : {"c", "d", "e"})
        link("a", sibling);
    EXPECT_EQ(tree("b"), "b (Object)\n"
                         "`- Up a (Link)\n"
                         "   `- Down 3 others (Link)\n");
    link("x", "a");
    link("c", "f");
    EXPECT_EQ(tree("b"), "b (Object)\n"
                         "`- Up a (Link)\n"
                         "   |- Down 2 others (Link)\n"
                         "   |- Down c (Link)\n"
                         "   |  `- Down f (Link)\n"
                         "   `- Up x (Link)\n");
}

TEST_F(ObjectTreeTest, CirclesEnd)
{
    link("a", "b");
    link("b", "c");
    link("c", "a");
    link("a", "a");
    EXPECT_EQ(tree("a"), "a (Object)\n"
                         "|- Down b (Link)\n"
                         "|  `- Down c (Link) ...\n"
                         "`- Up c (Link)\n"
                         "   `- Up b (Link) ...\n");
}

TEST_F(ObjectTreeTest, TheRemarkGivesWayFirst)
{
    link("a", "bcdefgh");
    EXPECT_EQ(tree("a", 18), "a (Object)\n`- Down bcdefgh (~\n");
    EXPECT_EQ(tree("a", 10), "a (Object)\n`- Down b~\n");
}

TEST_F(ObjectTreeTest, ObjectsAreTheSameHoweverTheirPathsAreWritten)
{
    link("a", "b");
    Host::ObjectPath& other = request_.makePath("root/other", "OBJECT");
    other.setHost("elsewhere");
    other.addKey("NAME", Host::Value::text(request_.arena(), "b"));
    EXPECT_EQ(graph_.indexOf(other), graph_.indexOf(object("b")));
    EXPECT_NE(graph_.indexOf(object("B")), graph_.indexOf(object("b")));
}

} // namespace
