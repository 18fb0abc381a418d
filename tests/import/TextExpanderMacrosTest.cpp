#include "import/TextExpanderMacros.h"

#include "tests/import/ImportSupport.h"

namespace plume {
namespace {

std::string converted(const std::string& text, ContentType type, std::string* losses = nullptr) {
    Snippet snippet(u"a", fromUtf8(text));
    snippet.setContentType(type);
    for (const std::string& loss : convertTextExpanderMacros(snippet)) {
        if (losses) *losses += loss + "\n";
    }
    return toUtf8(*snippet.plainTextContent());
}

TEST(TextExpanderMacros, AreWrittenInTodaysSyntax) {
    const struct {
        const char* before;
        const char* after;
    } cases[] = {
        {"100% sure, 50%", "100% sure, 50%"},
        {"%clipboard and %pasteboard", "【clipboard】 and 【clipboard】"},
        {"50%% off, %%value, %%%%|", "50% off, %value, %%|"},
        {"a%|b%<%>%^%v", "a【|】b【key:← code:123】【key:→ code:124】【key:↑ code:126】【key:↓ code:125】"},
        {"%key:enter%%key:Tab%%key:esc%%key:return%",
         "【key:↩ code:36】【key:⇥ code:48】【key:⎋ code:53】【key:↩ code:36】"},
        {"%snippet:;sig%Dear", "【snippet:;sig】Dear"},
        {"%snippet:my sig%", "【snippet:\"my sig\"】"},
        {"%fill:Who%, %field:Last name%", "【field:Who】, 【field:\"Last name\"】"},
        {"%filltext:name=Who%", "【field:Who】"},
        {"%filltext:name=Who:default=you:width=20%", "【field:Who value:you width:20】"},
        {"%filltext:default=you%", "【field value:you】"},
        {"%filltext:name=Url:default=http://x.org:width=5%", "【field:Url value:\"http://x.org\" width:5】"},
        {"%fillarea:name=Note:default=a\nb:height=3%", "【field:Note type:1 value:a\nb height:3】"},
        {"%fillpopup:name=Size:S:default=M:L%", "【field:Size type:2 value:S\nM\nL defaultIndex:1】"},
        {"%fillpopup:name=Size:S:M:default=S%", "【field:Size type:2 value:S\nM】"},
        {"%fillpopup:One:Two%", "【field type:2 value:One\nTwo】"},
        {"%filltop%a%fillpart:name=P:default=no%text%fillpartend%b", "a【field:P value:text optional:0 readonly】b"},
        {"%fillpart:name=P%a\nb%fillpartend%%fillpart:name=P%c%fillpartend%",
         "【field:P type:1 value:a\nb optional:1 readonly】【field:\"P 2\" value:c optional:1 readonly】"},
        {"%B %e, %Y", "【date:\"MMMM d, yyyy\"】"},
        {"%Y%m%d", "【date:yyyyMMdd】"},
        {"%A, %d/%m/%y", "【date:\"EEEE, dd/MM/yy\"】"},
        {"%b %1d and %a %1m day %j", "【date:\"MMM d\"】 and 【date:\"EEE M\"】 day 【date:DDD】"},
        {"%Y-%m-%d %H:%M:%S", "【date:yyyy-MM-dd】 【time:\"HH:mm:ss\"】"},
        {"%1I:%1M %p", "【time:\"h:m a\"】"},
        {"%Y %@+1D%d.%m. %@-2M%m", "【date:yyyy】 【date:dd.MM day:1】. 【date:MM month:-2 day:1】"},
        {"%@+1Y%@-1W%Y", "【date:yyyy year:1 day:-7】"},
        {"%@+90m%@-1h%@+5s%H:%M", "【time:\"HH:mm\" hour:-1 minute:90 second:5】"},
        {"%date:short%%time:HH:mm%", "【date:short】【time:\"HH:mm\"】"},
        {"%@+1D%date:yyyy-MM-dd%", "【date:yyyy-MM-dd day:1】"},
        {"%date:short", "%date:short"},
        {"%@+1x %@", "%@+1x %@"},
        {"%filltext:name=【a】%", "【field:[a]】"},
    };
    for (const auto& one : cases) {
        std::string losses;
        EXPECT_EQ(converted(one.before, ContentType::PlainText, &losses), one.after);
        EXPECT_EQ(losses, "") << one.before;
    }
}

TEST(TextExpanderMacros, ThatCannotBeSaidAreToldOf) {
    const struct {
        const char* before;
        const char* after;
        const char* loss;
    } cases[] = {
        {"%|a%\\b", "【|】ab", "the selection up to %\\ is left out\n"},
        {"%key:vend%", "%key:vend%", "the key vend is not known and stays as text\n"},
        {"%filldate:name=D%%filldate:name=%", "%filldate:name=D%%filldate:name=%",
         "the macro %filldate: is not known and stays as text\n"},
        {"%fillpart:name=P%a", "a", "the optional part P has no end and is always written\n"},
        {"%fillpart:name=P%a %fill:b%%fillpartend%c", "a 【field:b】c",
         "the optional part P holds macros and is always written\n"},
        {"%@+1h%H%d", "【time:HH hour:1】【date:dd】", "a date does not go on to the next day when hours are added\n"},
    };
    for (const auto& one : cases) {
        std::string losses;
        EXPECT_EQ(converted(one.before, ContentType::PlainText, &losses), one.after);
        EXPECT_EQ(losses, one.loss) << one.before;
    }
}

TEST(TextExpanderMacros, InScriptsLeaveTheCodeAlone) {
    EXPECT_EQ(converted("date +%Y-%m | tr %v; echo ${a%|b} %% %filltext:name=x% %clipboard", ContentType::ShellScript),
              "date +%Y-%m | tr %v; echo ${a%|b} %% 【field:x】 【clipboard】");
}

TEST(TextExpanderMacros, KeepTheLookOfRichText) {
    auto bold = std::make_shared<TextAttributes>();
    bold->underlineStyle = 1;
    AttributedString text(u"a ");
    text.append(u"%Y%%", bold);
    Snippet snippet(u"a", u"");
    snippet.setContentType(ContentType::RichText);
    snippet.setRichTextContent(text);
    convertTextExpanderMacros(snippet);
    AttributedString expected(u"a ");
    expected.append(u"【date:yyyy】%", bold);
    EXPECT_EQ(*snippet.richTextContent(), expected);
}

}  // namespace
}  // namespace plume
