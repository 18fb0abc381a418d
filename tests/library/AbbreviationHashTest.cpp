#include "library/AbbreviationHash.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <string>

#include "Foundation/Strings.h"

namespace plume {
namespace {

// The matcher folds the typed text once and walks from its end, unit by unit.
RC_GTEST_PROP(AbbreviationHash, GrowsFromTheEndOverTheFoldedUnits, ()) {
    const auto units = *rc::gen::container<std::u16string>(
        rc::gen::element(u'a', u'B', u'ß', u'Σ', u'ς', u'\xd801', u'\xdc00', u'\xdc28', u'\x0301'));
    std::uint64_t hash = EmptySuffixHash;
    const std::u16string foldedUnits = folded(units);
    for (std::size_t i = foldedUnits.size(); i > 0; --i) hash = extendSuffixHash(hash, foldedUnits[i - 1]);
    RC_ASSERT(hash == hashOfSuffix(units));
}

TEST(AbbreviationHash, TellsTextsApart) {
    const std::u16string texts[] = {u"", u"a", u"e", u"é", u"ab", u"ba", u"sig", u"sig ", u" sig", u"gis"};
    for (const auto& a : texts) {
        for (const auto& b : texts) EXPECT_EQ(hashOfSuffix(a) == hashOfSuffix(b), a == b) << toUtf8(a) << toUtf8(b);
    }
}

}  // namespace
}  // namespace plume
