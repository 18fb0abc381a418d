#include "library/AbbreviationHash.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <string>

#include "Foundation/Strings.h"

namespace plume {
namespace {

struct Pair {
    const char16_t* a;
    const char16_t* b;
    bool same;
};

TEST(AbbreviationHash, IgnoresCaseAndNothingElse) {
    const Pair pairs[] = {
        {u"sig", u"SIG", true},
        {u"ÄÖ", u"äö", true},
        {u"ΣΑΣ", u"σας", true},
        {u"\U00010400x", u"\U00010428X", true},  // letters beyond the basic plane have case too
        {u"sig", u"gis", false},
        {u"sig", u"sig ", false},
        {u"", u"a", false},
        {u"é", u"e", false},
    };
    for (const Pair& pair : pairs) {
        EXPECT_EQ(hashOfSuffix(pair.a) == hashOfSuffix(pair.b), pair.same) << toUtf8(pair.a) << " " << toUtf8(pair.b);
    }
}

TEST(AbbreviationHash, OfTheEmptyTextIsTheStart) {
    EXPECT_EQ(hashOfSuffix(u""), EmptySuffixHash);
}

// The matcher folds the typed text once and walks from its end, unit by unit.
RC_GTEST_PROP(AbbreviationHash, GrowsFromTheEndOverTheFoldedUnits, ()) {
    const auto units = *rc::gen::container<std::u16string>(
        rc::gen::element(u'a', u'B', u'ß', u'Σ', u'ς', u'\xd801', u'\xdc00', u'\xdc28', u'\x0301'));
    std::uint64_t hash = EmptySuffixHash;
    const std::u16string foldedUnits = folded(units);
    for (std::size_t i = foldedUnits.size(); i > 0; --i) hash = extendSuffixHash(hash, foldedUnits[i - 1]);
    RC_ASSERT(hash == hashOfSuffix(units));
}

}  // namespace
}  // namespace plume
