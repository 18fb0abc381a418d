#include "library/PLFunctionAvailability.h"

#include <gtest/gtest.h>

#include <cstdint>

namespace plume {
namespace {

struct Case {
    std::int64_t option;
    bool listed;
    bool unlisted;
    bool none;
};

TEST(PLFunctionAvailability, AdmitsApplicationsByItsOption) {
    const Case cases[] = {
        {0, true, true, true},    {1, false, true, true},    {2, true, false, false},
        {3, false, false, false}, {-1, false, false, false},
    };
    for (const Case& c : cases) {
        PLFunctionAvailability record;
        record.availability = c.option;
        record.applications = {u"org.editor", u"org.mail"};
        EXPECT_EQ(record.admitsApplication(u"org.mail"), c.listed) << c.option;
        EXPECT_EQ(record.admitsApplication(u"org.Mail"), c.unlisted) << c.option;
        EXPECT_EQ(record.admitsApplication(std::nullopt), c.none) << c.option;
    }
}

TEST(PLFunctionAvailability, AdmitsInputSourcesByItsOption) {
    const Case cases[] = {
        {0, true, true, true},
        {1, false, true, true},
        {2, true, false, false},
        {7, true, false, false},
    };
    for (const Case& c : cases) {
        PLFunctionAvailability record;
        record.inputMethodsOption = c.option;
        record.inputMethods = {u"us", u"de(neo)"};
        EXPECT_EQ(record.admitsInputSource(u"de(neo)"), c.listed) << c.option;
        EXPECT_EQ(record.admitsInputSource(u"de"), c.unlisted) << c.option;
        EXPECT_EQ(record.admitsInputSource(std::nullopt), c.none) << c.option;
    }
}

TEST(PLFunctionAvailability, AMissingListIsEmpty) {
    PLFunctionAvailability except{1, std::nullopt, 1, std::nullopt};
    EXPECT_TRUE(except.admitsApplication(u"org.mail"));
    EXPECT_TRUE(except.admitsInputSource(u"us"));
    PLFunctionAvailability only{2, std::nullopt, 2, std::nullopt};
    EXPECT_FALSE(only.admitsApplication(u"org.mail"));
    EXPECT_FALSE(only.admitsInputSource(u"us"));
}

}  // namespace
}  // namespace plume
