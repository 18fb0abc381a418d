#include "app/editing/ExportedFile.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "Foundation/Strings.h"
#include "Foundation/text/RTFD.h"
#include "import/Importers.h"
#include "tests/app/editing/EditedMachine.h"

namespace plume {
namespace {

using namespace test;
using ::testing::ElementsAre;
using ::testing::HasSubstr;
using ::testing::IsEmpty;

AttributedString coloured(const std::u16string& text) {
    TextAttributes attributes;
    attributes.foregroundColor = ColorAttribute{.red = 1};
    return AttributedString(text, std::make_shared<const TextAttributes>(attributes));
}

struct ExportedFileTest : ::testing::Test {
    ExportedFileTest() {
        mail = machine.addGroup(u"Mail", {u"sig=Regards,\nJo \"J\" Doe", u"hi=Hello 【field:Name】"}, u";");
        words = machine.addGroup(u"Wörter, „süß“", {u"btw=by the way", u"=no abbreviation"});
        mail->items()[0]->setLabel(u"Signature");
    }
    std::vector<std::string> readBack(const SnippetGroups& groups, const char* path) {
        const auto bytes = exportedFile(groups, path, std::nullopt);
        const auto imported = importFile(path, bytes.value());
        return imported ? described(imported.value().groups) : std::vector<std::string>{imported.error().message};
    }

    EditedMachine machine;
    std::shared_ptr<SnippetGroup> mail, words;
};

TEST_F(ExportedFileTest, OurImportersReadItBack) {
    const auto all = described(machine.editor.groups());
    EXPECT_EQ(readBack(machine.editor.groups(), "/x.plume"), all);
    EXPECT_EQ(readBack(machine.editor.groups(), "/x.JSON"), all);
    EXPECT_EQ(readBack({mail}, "/x.plume"), described({mail}));
    EXPECT_THAT(readBack(machine.editor.groups(), "/x.csv"),
                ElementsAre("x: ;sig=Regards,\nJo \"J\" Doe ;hi=Hello 【field:Name】 btw=by the way =no abbreviation"));
    const auto one = importFile("/x.csv", exportedFile({mail}, "/x.csv", std::nullopt).value());
    EXPECT_EQ(one.value().groups.front()->items().front()->label(), u"Signature");
    EXPECT_THAT(readBack({}, "/x.json"), IsEmpty());
}

TEST_F(ExportedFileTest, AnotherEndingIsAnError) {
    for (const char* path : {"/x.txt", "/x", "/x.plume.bak"}) {
        const auto bytes = exportedFile(machine.editor.groups(), path, std::nullopt);
        ASSERT_FALSE(bytes) << path;
        EXPECT_THAT(bytes.error().message, HasSubstr(std::string(path) + ": "));
    }
}

TEST_F(ExportedFileTest, RtfIsForPeople) {
    const auto rich = std::make_shared<Snippet>(u"warn", u"");
    rich->setContentType(ContentType::RichText);
    rich->setRichTextContent(coloured(u"Careful"));
    const auto script = std::make_shared<Snippet>(u"now", u"date");
    script->setContentType(ContentType::ShellScript);
    words->addItems({rich, script});
    const auto text = attributedStringFromRTF(exportedFile(machine.editor.groups(), "/x.rtf", std::nullopt).value());
    ASSERT_TRUE(text);
    const std::u16string& plain = text.value().string();
    EXPECT_EQ(plain,
              u"Mail\n\n;sig – Signature\nRegards,\nJo \"J\" Doe\n\n;hi\nHello 【field:Name】\n\nWörter, „süß“\n\n"
              u"btw\nby the way\n\n\nno abbreviation\n\nwarn\nCareful\n\nnow\ndate\n\n");
    const auto at = [&](const char16_t* what) { return *text.value().attributesAt(plain.find(what)); };
    EXPECT_GT(at(u"Mail").font->size, at(u";sig").font->size);
    EXPECT_TRUE(at(u";sig").font->bold);
    EXPECT_FALSE(at(u"Regards").font->bold);
    EXPECT_EQ(at(u"Careful").foregroundColor->red, 1);
    EXPECT_FALSE(at(u"now").foregroundColor.has_value());
    EXPECT_NE(at(u"date").font->family, at(u"Regards").font->family);
}

TEST_F(ExportedFileTest, ASelectionKeepsGroupsAndTheLibraryStaysAsItIs) {
    const struct {
        LibrarySelection selection;
        std::vector<std::string> groups;
    } cases[] = {
        {{}, {}},
        {{{mail}, {}}, {"Mail: sig=Regards,\nJo \"J\" Doe hi=Hello 【field:Name】"}},
        {{{}, {words->items()[0], mail->items()[1]}},
         {"Mail: hi=Hello 【field:Name】", "Wörter, „süß“: btw=by the way"}},
        {{{mail}, {mail->items()[1], words->items()[0]}},
         {"Mail: sig=Regards,\nJo \"J\" Doe hi=Hello 【field:Name】", "Wörter, „süß“: btw=by the way"}},
    };
    const std::string before = machine.bytes();
    for (const auto& each : cases) {
        const SnippetGroups groups = groupsOfSelection(each.selection, machine.editor.groups());
        EXPECT_EQ(described(groups), each.groups);
        for (const auto& group : groups)
            EXPECT_EQ(group->abbreviationPrefix(),
                      *group->name() == u"Mail" ? mail->abbreviationPrefix() : words->abbreviationPrefix());
    }
    EXPECT_EQ(machine.bytes(), before);
    EXPECT_EQ(mail->items()[1]->parentGroup(), mail);
}

}  // namespace
}  // namespace plume
