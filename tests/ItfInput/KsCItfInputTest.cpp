#include "ItfInput/KsCItfInput.h"
#include "ItfTestSupport.h"

#include <unistd.h>

namespace {

// Runs the collection with `dir` as the current directory.
class KsCItfInputTest : public ItfHostTest {
protected:
    std::vector<std::string> collect(bool expected = true) {
        auto previous = std::filesystem::current_path();
        std::filesystem::current_path(dir.path());
        KsCItfInput input;
        input.init();
        KsCItfInputFileList files;
        EXPECT_EQ(input.collectInputFiles(files), expected);
        std::filesystem::current_path(previous);
        std::vector<std::string> names;
        for (KsCItfInputFile* file : files) {
            names.push_back(file->getBaseName().str() + "=" + file->getContent().str());
            delete file;
        }
        return names;
    }
    ItfTempDir dir;
};

TEST_F(KsCItfInputTest, TakesTheTestFilesInTheirOrder) {
    dir.write("b.itf", "B");
    dir.write("a.itf", "A");
    dir.write("znfxp_mul.itf", "Z");
    dir.write("notes.txt", "not taken");
    dir.write("xitf", "X");
    dir.write("itf", "I");
    dir.write("empty.itf", "");
    dir.write("a_itf", "second a");
    std::filesystem::create_directory(dir.path() / "old.itf");
    std::filesystem::create_symlink("missing.itf", dir.path() / "dangling.itf");
    EXPECT_EQ(collect(), (std::vector<std::string>{"znfxp_mul=Z", "=I", "=X", "a=A", "a=second a",
                                                   "b=B", "empty="}));
    EXPECT_TRUE(messages().empty());
}

TEST_F(KsCItfInputTest, ReadsTheWholeTextByteForByte) {
    std::string text = "line 1\r\nline 2\n\xe4\xff";
    text += std::string(200000, 'x');
    dir.write("big.itf", text);
    auto names = collect();
    ASSERT_EQ(names.size(), 1u);
    EXPECT_EQ(names[0], "big=" + text);
}

TEST_F(KsCItfInputTest, EmptyDirectoryGivesNoFiles) {
    EXPECT_TRUE(collect().empty());
}

TEST_F(KsCItfInputTest, UnreadableFileIsReported) {
    if (::geteuid() == 0)
        GTEST_SKIP() << "root reads every file";
    dir.write("secret.itf", "x");
    std::filesystem::permissions(dir.path() / "secret.itf", std::filesystem::perms::none);
    collect(false);
    ASSERT_EQ(messages().size(), 1u);
    EXPECT_EQ(messages()[0].text, "ICode test frame error: Error when opening file secret.itf");
}

} // namespace
