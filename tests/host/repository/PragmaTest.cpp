// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Files that include others, and namespaces.

#include "tests/host/repository/MofTest.h"
#include "tests/support/TemporaryFolder.h"

#include <filesystem>

namespace PragmaTests {

using Testing::NameSpace;
using Testing::TemporaryFolder;

class PragmaTest : public ::testing::Test {
protected:
    std::unique_ptr<const Host::Repository> compileFile(const std::string& file)
    {
        Host::Compiler compiler;
        compiler.compileFile(file, NameSpace);
        return std::move(compiler).finish();
    }

    // With the folder's path as FOLDER.
    std::string errorOf(const std::string& file)
    {
        try {
            compileFile(file);
            return "no error";
        } catch (const std::runtime_error& error) {
            std::string text = error.what();
            const std::string path = folder_.path().string();
            for (auto at = text.find(path); at != std::string::npos; at = text.find(path))
                text.replace(at, path.size(), "FOLDER");
            return text;
        }
    }

    TemporaryFolder folder_;
};

TEST_F(PragmaTest, includesAreRelativeToTheirFile)
{
    std::filesystem::create_directory(folder_.path() / "sub");
    folder_.write("sub/b.mof", "#pragma include (\"c.mof\")\nclass B : C {};");
    folder_.write("sub/c.mof", "class C {};");
    const std::string file =
        folder_.write("a.mof", "#pragma include (\"sub/b.mof\")\nclass A : B {};");
    EXPECT_TRUE(compileFile(file)->isDerivedFrom(NameSpace, "A", "C"));
}

TEST_F(PragmaTest, errorsNameTheIncludedFile)
{
    folder_.write("b.mof", "\nclass B : C {};");
    const std::string file = folder_.write("a.mof", "#pragma include (\"b.mof\")");
    EXPECT_EQ(errorOf(file), "FOLDER/b.mof:2:11: superclass C is not declared");
}

TEST_F(PragmaTest, missingFilesAreNamedWhereTheyAreIncluded)
{
    const std::string file = folder_.write("a.mof", "\n  #pragma include (\"b.mof\")");
    EXPECT_EQ(errorOf(file), "FOLDER/a.mof:2:20: FOLDER/b.mof: No such file or directory");
    EXPECT_EQ(errorOf(folder_.path() / "c.mof"), "FOLDER/c.mof: No such file or directory");
}

TEST_F(PragmaTest, onlyRegularFilesOfReasonableSizeAreRead)
{
    EXPECT_EQ(errorOf(folder_.path()), "FOLDER: is a folder");
    EXPECT_EQ(errorOf("/dev/null"), "/dev/null: is no regular file");
    const std::string large = folder_.write("large.mof", std::string((4U << 20U) + 1, ' '));
    EXPECT_EQ(errorOf(large), "FOLDER/large.mof: is larger than 4 MiB");
    const std::string largest = folder_.write("largest.mof", std::string(4U << 20U, ' '));
    EXPECT_EQ(errorOf(largest), "no error");
}

TEST_F(PragmaTest, circlesAreFoundByWhateverPath)
{
    std::filesystem::create_directory(folder_.path() / "sub");
    folder_.write("sub/b.mof", "#pragma include (\"../sub/../link.mof\")");
    const std::string file = folder_.write("a.mof", "#pragma include (\"sub/b.mof\")");
    std::filesystem::create_symlink(file, folder_.path() / "link.mof");
    EXPECT_EQ(
        errorOf(file), "FOLDER/sub/b.mof:1:18: FOLDER/sub/../sub/../link.mof: includes itself");
    EXPECT_EQ(errorOf(folder_.write("own.mof", "#pragma include (\"own.mof\")")),
        "FOLDER/own.mof:1:18: FOLDER/own.mof: includes itself");
}

TEST_F(PragmaTest, aFileMayBeIncludedAgainWhenItIsDone)
{
    folder_.write("comment.mof", "// nothing");
    const std::string file = folder_.write(
        "a.mof", "#pragma include (\"comment.mof\")\n#pragma include (\"comment.mof\")");
    EXPECT_EQ(errorOf(file), "no error");
}

TEST_F(PragmaTest, includesNestToALimit)
{
    for (int i = 0; i < 20; ++i)
        folder_.write(
            std::to_string(i) + ".mof", "#pragma include (\"" + std::to_string(i + 1) + ".mof\")");
    folder_.write("20.mof", "");
    EXPECT_EQ(errorOf(folder_.path() / "4.mof"), "no error");
    EXPECT_EQ(errorOf(folder_.path() / "3.mof"),
        "FOLDER/19.mof:1:18: FOLDER/20.mof: too many files are included");
}

TEST_F(PragmaTest, includesThatMultiplyAreStopped)
{
    for (int i = 0; i < 10; ++i) {
        std::string text;
        for (int repetition = 0; repetition < 10; ++repetition)
            text += "#pragma include (\"" + std::to_string(i + 1) + ".mof\")\n";
        folder_.write(std::to_string(i) + ".mof", text);
    }
    folder_.write("10.mof", "");
    EXPECT_NE(
        errorOf(folder_.path() / "0.mof").find("too many files are included"), std::string::npos);
}

TEST_F(PragmaTest, textsReadWhatTheyIncludeThroughTheReader)
{
    Host::Compiler compiler([](const std::filesystem::path& file) -> std::string {
        EXPECT_EQ(file, "folder/b.mof");
        return "class B {};";
    });
    compiler.compileText("#pragma include (\"b.mof\") class A : B {};", "folder/a.mof", NameSpace);
    EXPECT_NE(std::move(compiler).finish()->findClass(NameSpace, "A"), nullptr);
}

TEST_F(PragmaTest, aNamespaceHoldsForTheRestOfTheFileAndWhatItIncludes)
{
    folder_.write("b.mof", "class B {};\n#pragma namespace (\"root/three\")\nclass C {};");
    const std::string file = folder_.write("a.mof", R"(
        class A {};
        #pragma namespace ("/root/two/")
        class A {};
        #pragma include ("b.mof")
        class D {};)");
    const auto repository = compileFile(file);
    ASSERT_EQ(repository->namespaces().size(), 3U);
    EXPECT_EQ(repository->namespaces()[1]->name(), "root/two");
    EXPECT_NE(repository->findClass(NameSpace, "A"), nullptr);
    EXPECT_NE(repository->findClass("root/two", "A"), nullptr);
    EXPECT_NE(repository->findClass("root/two", "B"), nullptr);
    EXPECT_NE(repository->findClass("root/two", "D"), nullptr);
    EXPECT_EQ(repository->findClass("root/two", "C"), nullptr);
    EXPECT_NE(repository->findClass("ROOT/Three", "C"), nullptr);
}

TEST_F(PragmaTest, namespacesShareNothing)
{
    EXPECT_EQ(Testing::errorOf("class A {};\n#pragma namespace (\"root/two\")\nclass B : A {};"),
        "test.mof:3:11: superclass A is not declared");
    EXPECT_EQ(Testing::errorOf("#pragma namespace (\"root/two\")\n[Abstract] class B {};"),
        "test.mof:2:2: qualifier Abstract is not declared");
}

TEST_F(PragmaTest, namespacesHaveNames)
{
    for (const char* const name : {"", "/", "root//cimv2", "root cimv2", "http://host/root"})
        EXPECT_EQ(Testing::errorOf("#pragma namespace (\"" + std::string(name) + "\")"),
            "test.mof:1:20: \"" + std::string(name) + "\" is no name of a namespace");
    Host::Compiler compiler;
    EXPECT_THROW(compiler.compileText("", "test.mof", "a b"), std::invalid_argument);
}

TEST_F(PragmaTest, namespacesAreNotWithoutNumber)
{
    std::string text;
    for (int i = 1; i <= 256; ++i)
        text += "#pragma namespace (\"root/" + std::to_string(i) + "\")\n";
    EXPECT_EQ(Testing::errorOf(text), "test.mof:256:20: too many namespaces");
}

TEST_F(PragmaTest, namesOfFilesFitIntoOneLine)
{
    EXPECT_EQ(Testing::errorOf("#pragma include (\"a\\nb\")"),
        "test.mof:1:18: \"a\\x0ab\" is no name of a file");
}

TEST_F(PragmaTest, otherPragmasHaveNoEffect)
{
    EXPECT_EQ(Testing::errorOf("#pragma locale (\"en_US\")\n# pragma whatever (\"x\" \"y\")"),
        "no error");
}

} // namespace PragmaTests
