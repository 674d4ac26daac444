// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The pragmas: included files and namespaces.

#include "tests/host/repository/MofTest.h"
#include "tests/support/TemporaryFolder.h"

#include <filesystem>

namespace PragmaTests {

using Testing::testNameSpace;

class PragmaTest : public ::testing::Test {
protected:
    std::unique_ptr<const Host::Repository> compileFile(const std::string& file)
    {
        Host::Compiler compiler;
        compiler.compileFile(file, testNameSpace);
        return std::move(compiler).finish();
    }

    std::string errorOf(const std::string& file)
    {
        return Testing::errorOf([&] { compileFile(file); });
    }

    Testing::TemporaryFolder folder_;
};

TEST_F(PragmaTest, IncludesAreRelativeToTheirFile)
{
    std::filesystem::create_directory(folder_.path() / "sub");
    folder_.write("sub/b.mof", "#pragma include (\"c.mof\")\nclass B : C {};");
    folder_.write("sub/c.mof", "class C {};");
    const std::string file =
        folder_.write("a.mof", "#pragma include (\"sub/b.mof\")\nclass A : B {};");
    EXPECT_TRUE(compileFile(file)->isDerivedFrom(testNameSpace, "A", "C"));
}

TEST_F(PragmaTest, ErrorsNameTheIncludedFile)
{
    const std::string included = folder_.write("b.mof", "\nclass B : C {};");
    const std::string file = folder_.write("a.mof", "#pragma include (\"b.mof\")");
    EXPECT_EQ(errorOf(file), included + ":2:11: C is no declared class");
    std::filesystem::remove(included);
    EXPECT_EQ(errorOf(file), included + ": No such file or directory");
    std::filesystem::create_directory(included);
    EXPECT_EQ(errorOf(file), included + ": Is a directory");
}

TEST_F(PragmaTest, AFileThatIncludesItselfIsAnError)
{
    const std::string own = folder_.write("own.mof", "\n#pragma include (\"own.mof\")");
    EXPECT_EQ(errorOf(own), own + ":2:18: own.mof includes itself");
    std::filesystem::create_directory(folder_.path() / "sub");
    const std::string inner = folder_.write("sub/b.mof", "#pragma include (\"../a.mof\")");
    const std::string outer = folder_.write("a.mof", "#pragma include (\"sub/b.mof\")");
    EXPECT_EQ(errorOf(outer), inner + ":1:18: ../a.mof includes itself");
}

TEST_F(PragmaTest, AFileIsIncludedAsOftenAsNamespacesNeedIt)
{
    folder_.write("b.mof", "class B {};");
    const auto repository = compileFile(folder_.write("a.mof", R"(
        #pragma include ("b.mof")
        #pragma namespace ("root/two")
        #pragma include ("b.mof"))"));
    EXPECT_NE(repository->findClass(testNameSpace, "B"), nullptr);
    EXPECT_NE(repository->findClass("root/two", "B"), nullptr);
}

TEST_F(PragmaTest, ANamespaceHoldsForTheRestOfTheFileAndWhatItIncludes)
{
    folder_.write("b.mof", "class B {};\n#pragma namespace (\"root/three\")\nclass C {};");
    const auto repository = compileFile(folder_.write("a.mof", R"(
        class A {};
        #pragma namespace ("/root/two/")
        class A {};
        #pragma include ("b.mof")
        class D {};)"));
    ASSERT_EQ(repository->namespaces().size(), 3U);
    EXPECT_EQ(repository->namespaces()[1]->name(), "root/two");
    EXPECT_NE(repository->findClass(testNameSpace, "A"), nullptr);
    EXPECT_NE(repository->findClass("root/two", "A"), nullptr);
    EXPECT_NE(repository->findClass("root/two", "B"), nullptr);
    EXPECT_NE(repository->findClass("root/two", "D"), nullptr);
    EXPECT_EQ(repository->findClass("root/two", "C"), nullptr);
    EXPECT_NE(repository->findClass("ROOT/Three", "C"), nullptr);
}

TEST_F(PragmaTest, NamespacesShareNothing)
{
    EXPECT_EQ(Testing::errorOf("class A {};\n#pragma namespace (\"root/two\")\nclass B : A {};"),
        "test.mof:3:11: A is no declared class");
    EXPECT_EQ(Testing::errorOf("#pragma namespace (\"root/two\")\n[Abstract] class B {};"),
        "test.mof:2:2: Abstract is no declared qualifier");
}

} // namespace PragmaTests
