#include "library/LibraryFile.h"

#include <gtest/gtest.h>

#include "tests/library/LibrarySupport.h"

namespace plume {
namespace {

TEST(LibraryFile, GivesBackWhatItWrote) {
    const LibraryFile::Groups before = {test::fullGroup(), SnippetGroup::make()};
    const std::string written = LibraryFile::write(before);
    const Result<LibraryFile::Groups> read = LibraryFile::read(written, "l.json");
    ASSERT_TRUE(read.ok()) << read.error().message;
    ASSERT_EQ(read.value().size(), 2u);
    for (std::size_t i = 0; i < before.size(); ++i) {
        EXPECT_EQ(test::fieldsOf(*read.value()[i]), test::fieldsOf(*before[i]));
    }
    EXPECT_EQ(read.value()[0]->items()[0]->uuid(), before[0]->items()[0]->uuid());
    EXPECT_EQ(LibraryFile::write(read.value()), written);
}

TEST(LibraryFile, LeavesNewRecordsAsTheyAre) {
    const auto read = LibraryFile::read(R"([{"items": [{}]}, {"name": null, "delimiters": " \n"}])", "l.json");
    ASSERT_TRUE(read.ok()) << read.error().message;
    const auto fresh = SnippetGroup::make();
    fresh->addItem(std::make_shared<Snippet>());
    EXPECT_EQ(test::fieldsOf(*read.value()[0]), test::fieldsOf(*fresh));
    EXPECT_EQ(read.value()[0]->items()[0]->parentGroup(), read.value()[0]);
    EXPECT_TRUE(read.value()[0]->items()[0]->uuid().has_value());
    EXPECT_EQ(read.value()[1]->name(), std::nullopt);
    EXPECT_EQ(read.value()[1]->delimiters(), CharacterSet::withCharacters(u" \r")) << "a line feed stands for Return";
}

}  // namespace
}  // namespace plume
