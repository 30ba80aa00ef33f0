#include "platform/foundation/NSKeyedArchiver.h"

#include "platform/foundation/Exceptions.h"
#include "platform/foundation/KeyedArchiveSupport.h"
#include "platform/foundation/NSDate.h"
#include "platform/foundation/NSMutableSet.h"
#include "platform/foundation/NSOrderedSet.h"
#include "platform/foundation/NSURL.h"
#include "platform/foundation/NSValue.h"
#include "support/TemporaryProfile.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <fstream>

namespace orvo::NSKeyedArchiverTests {
namespace {

using testing::Box;
using testing::Crate;
using testing::Loose;

std::shared_ptr<NSData> archived(const std::shared_ptr<NSObject>& root) {
    std::shared_ptr<NSError> error;
    auto data =
        NSKeyedArchiver::archivedDataWithRootObject_requiringSecureCoding_error(root, true, &error);
    EXPECT_TRUE(data) << descriptionOf(error);
    return data;
}

/// The archive as the text of its property list.
std::string dump(const std::shared_ptr<NSObject>& root) {
    return PropertyList::read(archived(root)->bytes())->description();
}

std::string failure(const std::shared_ptr<NSObject>& root, bool requiresSecureCoding = true) {
    std::shared_ptr<NSError> error;
    EXPECT_FALSE(NSKeyedArchiver::archivedDataWithRootObject_requiringSecureCoding_error(
        root, requiresSecureCoding, &error));
    if (!error)
        return "(no error)";
    EXPECT_EQ(error->domain(), NSCocoaErrorDomain);
    EXPECT_EQ(error->code(), NSCoderInvalidValueError);
    return error->localizedDescription();
}

std::string wholeArchive(const std::string& objects) {
    return "{$version = 100000; $archiver = NSKeyedArchiver; $top = {root = UID(1)}; $objects = "
           "($null, " +
           objects + ")}";
}

TEST(NSKeyedArchiver, TextsNumbersAndDataStandAsTheyAre) {
    EXPECT_EQ(dump(NSString::string("Line 7")), wholeArchive("Line 7"));
    EXPECT_EQ(dump(NSNumber::numberWithInteger(-7)), wholeArchive("-7"));
    EXPECT_EQ(dump(NSData::dataWithString("ab")), wholeArchive("{length = 2, bytes = 0x6162}"));
}

TEST(NSKeyedArchiver, ANilRootRefersToNil) {
    EXPECT_EQ(dump(nullptr),
              "{$version = 100000; $archiver = NSKeyedArchiver; $top = {root = UID(0)}; $objects = "
              "($null)}");
}

TEST(NSKeyedArchiver, CollectionsAndValuesHaveTheirPublicLayout) {
    const auto text = [](const char* utf8) {
        return NSString::string(utf8);
    };
    EXPECT_EQ(dump(NSArray::arrayWithObjects({text("a"), text("b")})),
              wholeArchive("{NS.objects = (UID(2), UID(3)); $class = UID(4)}, a, b, "
                           "{$classname = NSArray; $classes = (NSArray, NSObject)}"));
    EXPECT_EQ(dump(NSDictionary::dictionaryWithTextKeys({{"k", text("v")}})),
              wholeArchive("{NS.keys = (UID(2)); NS.objects = (UID(3)); $class = UID(4)}, k, v, "
                           "{$classname = NSDictionary; $classes = (NSDictionary, NSObject)}"));
    EXPECT_EQ(dump(NSDate::dateWithTimeIntervalSinceReferenceDate(1.5)),
              wholeArchive("{NS.time = 1.5; $class = UID(2)}, "
                           "{$classname = NSDate; $classes = (NSDate, NSObject)}"));
    EXPECT_EQ(
        dump(NSURL::URLWithString("orvo://?t=r")),
        wholeArchive("{NS.base = UID(0); NS.relative = UID(2); $class = UID(3)}, orvo://?t=r, "
                     "{$classname = NSURL; $classes = (NSURL, NSObject)}"));
    EXPECT_EQ(dump(NSOrderedSet::orderedSetWithObjects({text("a"), text("b")})),
              wholeArchive("{NS.object.0 = UID(2); NS.object.1 = UID(3); $class = UID(4)}, a, b, "
                           "{$classname = NSOrderedSet; $classes = (NSOrderedSet, NSObject)}"));
    const auto set = NSMutableSet::set();
    set->addObject(text("a"));
    EXPECT_EQ(
        dump(set),
        wholeArchive("{NS.objects = (UID(2)); $class = UID(3)}, a, "
                     "{$classname = NSMutableSet; $classes = (NSMutableSet, NSSet, NSObject)}"));
    EXPECT_EQ(dump(NSError::errorWithDomain_code_userInfo("D", 3, nullptr)),
              wholeArchive("{NSDomain = UID(2); NSCode = 3; NSUserInfo = UID(0); $class = UID(3)}, "
                           "D, {$classname = NSError; $classes = (NSError, NSObject)}"));
}

TEST(NSKeyedArchiver, AnObjectIsADictionaryOfItsKeysInTheirOrder) {
    const auto box = Box::boxNamed("b");
    box->isOpen = true;
    EXPECT_EQ(dump(box),
              wholeArchive("{name = UID(2); open = 1; weight = 0; height = 0; boxes = UID(0); "
                           "next = UID(0); $class = UID(3)}, b, "
                           "{$classname = Box; $classes = (Box, NSObject)}"));
}

TEST(NSKeyedArchiver, AClassIsDescribedOnceWithAllItDerivesFrom) {
    const auto crate = std::make_shared<Crate>();
    crate->next = std::make_shared<Crate>();
    EXPECT_EQ(dump(crate),
              wholeArchive("{name = UID(0); open = 0; weight = 0; height = 0; boxes = UID(0); "
                           "next = UID(2); $class = UID(3)}, "
                           "{name = UID(0); open = 0; weight = 0; height = 0; boxes = UID(0); "
                           "next = UID(0); $class = UID(3)}, "
                           "{$classname = Crate; $classes = (Crate, Box, NSObject)}"));
}

TEST(NSKeyedArchiver, AnObjectIsArchivedOnceByIdentity) {
    const auto date = NSDate::dateWithTimeIntervalSinceReferenceDate(5);
    const auto other = NSDate::dateWithTimeIntervalSinceReferenceDate(5);
    EXPECT_EQ(dump(NSArray::arrayOf<NSDate>({date, date, other})),
              wholeArchive("{NS.objects = (UID(2), UID(2), UID(4)); $class = UID(5)}, "
                           "{NS.time = 5; $class = UID(3)}, "
                           "{$classname = NSDate; $classes = (NSDate, NSObject)}, "
                           "{NS.time = 5; $class = UID(3)}, "
                           "{$classname = NSArray; $classes = (NSArray, NSObject)}"));
}

TEST(NSKeyedArchiver, EqualTextsAreOneObjectButTrueIsNotOne) {
    EXPECT_EQ(dump(NSArray::arrayWithObjects({NSString::string("1"),
                                              NSString::string("1"),
                                              NSNumber::numberWithInteger(1),
                                              NSNumber::numberWithBool(true),
                                              NSNumber::numberWithDouble(1),
                                              NSData::dataWithString("1")})),
              wholeArchive("{NS.objects = (UID(2), UID(2), UID(3), UID(4), UID(5), UID(6)); "
                           "$class = UID(7)}, 1, 1, 1, 1, {length = 1, bytes = 0x31}, "
                           "{$classname = NSArray; $classes = (NSArray, NSObject)}"));
}

TEST(NSKeyedArchiver, TheSameContentGivesTheSameBytes) {
    const auto make = [] {
        auto box = Box::boxNamed("outer");
        box->height = 0.1;
        box->boxes = NSArray::arrayOf<Box>({Box::boxNamed("a"), Box::boxNamed("b")});
        return box;
    };
    EXPECT_TRUE(equal(archived(make()), archived(make())));
    const auto other = make();
    other->height = 0.2;
    EXPECT_FALSE(equal(archived(make()), archived(other)));
}

TEST(NSKeyedArchiver, AKeyThatLooksLikeTheArchivesOwnIsEscaped) {
    const auto archiver = NSKeyedArchiver::initRequiringSecureCoding(true);
    archiver->encodeBool_forKey(true, "$class");
    const auto data = archiver->encodedData();
    EXPECT_EQ(PropertyList::read(data->bytes())->description(),
              "{$version = 100000; $archiver = NSKeyedArchiver; $top = {$$class = 1}; $objects = "
              "($null)}");
    EXPECT_TRUE(NSKeyedUnarchiver::initForReadingFromData_error(data)->decodeBoolForKey("$class"));
}

TEST(NSKeyedArchiver, WhatSupportsNoSecureCodingIsArchivedOnlyWithoutIt) {
    const auto loose = std::make_shared<Loose>();
    EXPECT_EQ(failure(loose), "keyed archive: the class Loose supports no secure coding");
    EXPECT_EQ(failure(NSArray::arrayOf<Loose>({loose})),
              "keyed archive: the class Loose supports no secure coding");
    EXPECT_TRUE(
        NSKeyedArchiver::archivedDataWithRootObject_requiringSecureCoding_error(loose, false));
}

TEST(NSKeyedArchiver, SecureCodingIsSaidByTheObject) {
    EXPECT_TRUE(supportsSecureCoding(Box::boxNamed("x").get()));
    EXPECT_TRUE(supportsSecureCoding(NSURL::URLWithString("a:b").get()));
    EXPECT_FALSE(supportsSecureCoding(std::make_shared<Loose>().get()));
    EXPECT_FALSE(supportsSecureCoding(NSValue::valueWithRange({1, 2}).get()));
    EXPECT_FALSE(supportsSecureCoding(nullptr));
}

TEST(NSKeyedArchiver, WhatCannotBeArchivedIsSaid) {
    EXPECT_EQ(failure(NSValue::valueWithRange({1, 2})),
              "keyed archive: an object of class NSValue cannot be archived");
    EXPECT_EQ(
        failure(NSError::errorWithDomain_code_userInfo(
            "D",
            1,
            NSDictionary::dictionaryWithTextKeys({{"range", NSValue::valueWithRange({1, 2})}}))),
        "keyed archive: an object of class NSValue cannot be archived");
}

TEST(NSKeyedArchiver, AnObjectThatContainsItselfIsAnError) {
    const auto box = Box::boxNamed("x");
    box->next = box;
    EXPECT_EQ(failure(box), "keyed archive: an object of class Box contains itself");
    box->next = nullptr; // lets go of itself
}

TEST(NSKeyedArchiver, DepthAndUnfoldedSizeHaveLimits) {
    const auto chain = [](std::size_t length) {
        auto box = Box::boxNamed("x");
        for (std::size_t i = 1; i < length; ++i) {
            auto outer = Box::boxNamed("x");
            outer->next = box;
            box = outer;
        }
        return box;
    };
    EXPECT_TRUE(archived(chain(KeyedArchive::MaximumDepth - 1))); // the texts are one level more
    EXPECT_EQ(failure(chain(KeyedArchive::MaximumDepth + 1)),
              "keyed archive: the objects are nested too deep");

    auto array = NSArray::array();
    for (int i = 0; i < 30; ++i)
        array = NSArray::arrayOf<NSArray>({array, array});
    EXPECT_EQ(failure(array), "keyed archive: the objects are nested too deep, or too many");
}

TEST(NSKeyedArchiver, TheFunctionCanBeReplaced) {
    std::vector<std::pair<std::shared_ptr<NSObject>, bool>> asked;
    const auto replaced = NSKeyedArchiver::archiving().overrideWith(
        [&](const auto& root, bool requiresSecureCoding, auto*) {
            asked.emplace_back(root, requiresSecureCoding);
            return std::shared_ptr<NSData>();
        });
    const auto root = NSString::string("x");
    EXPECT_FALSE(
        NSKeyedArchiver::archivedDataWithRootObject_requiringSecureCoding_error(root, true));
    ASSERT_EQ(asked.size(), 1U);
    EXPECT_EQ(asked[0].first, root);
    EXPECT_TRUE(asked[0].second);
}

TEST(NSKeyedArchiver, WritesOnlyAndOnce) {
    const auto archiver = NSKeyedArchiver::initRequiringSecureCoding(true);
    EXPECT_THROW((void)archiver->decodeBoolForKey("x"), NSInvalidArgumentException);
    EXPECT_THROW((void)archiver->containsValueForKey("x"), NSInvalidArgumentException);
    EXPECT_TRUE(archiver->encodedData());
    EXPECT_THROW(archiver->encodeBool_forKey(true, "x"), NSInvalidArgumentException);
    EXPECT_THROW((void)archiver->encodedData(), NSInvalidArgumentException);
}

class NSKeyedArchiverWithOthers : public ::testing::Test {
protected:
    void SetUp() override {
        const auto box = Box::boxNamed("Zürich");
        box->isOpen = true;
        box->boxes = NSArray::arrayOf<Box>({Box::boxNamed("a"), std::make_shared<Crate>()});
        const auto root = NSDictionary::dictionaryWithTextKeys(
            {{"box", box},
             {"at", NSDate::dateWithTimeIntervalSinceReferenceDate(60)},
             {"count", NSNumber::numberWithInteger(70000)}});
        std::ofstream file(path("archive.plist"), std::ios::binary);
        file << archived(root)->stringView();
    }
    [[nodiscard]] std::string path(const char* name) const {
        return (folder.path() / name).string();
    }
    static bool runs(const std::string& command) {
        return std::system((command + " >/dev/null 2>&1").c_str()) == 0;
    }

    testing::TemporaryFolder folder;
};

TEST_F(NSKeyedArchiverWithOthers, PlistutilReadsTheArchive) {
    if (!runs("command -v plistutil"))
        GTEST_SKIP() << "plistutil is not installed";
    ASSERT_TRUE(
        runs("plistutil -i " + path("archive.plist") + " -f xml -o " + path("archive.xml")));
    std::ifstream file(path("archive.xml"));
    const std::string xml{std::istreambuf_iterator<char>(file), {}};
    for (const char* expected : {"<string>NSKeyedArchiver</string>",
                                 "<integer>100000</integer>",
                                 "<key>CF$UID</key>",
                                 "<string>Zürich</string>",
                                 "<string>Crate</string>\n"})
        EXPECT_NE(xml.find(expected), std::string::npos) << expected << " in " << xml;
}

TEST_F(NSKeyedArchiverWithOthers, AnotherReaderFollowsItsReferences) {
    if (!runs("python3 -c 'import plistlib'"))
        GTEST_SKIP() << "python3 with plistlib is not installed";
    std::ofstream(path("check.py")) << R"(import plistlib, sys
archive = plistlib.load(open(sys.argv[1], 'rb'))
assert archive['$archiver'] == 'NSKeyedArchiver' and archive['$version'] == 100000
objects = archive['$objects']
assert objects[0] == '$null'

def follow(uid):
    value = objects[uid.data]
    if not isinstance(value, dict):
        return None if uid.data == 0 else value
    name = objects[value['$class'].data]
    assert name['$classes'][0] == name['$classname'] and name['$classes'][-1] == 'NSObject'
    if name['$classname'] == 'NSDictionary':
        return {follow(k): follow(v) for k, v in zip(value['NS.keys'], value['NS.objects'])}
    if name['$classname'] == 'NSArray':
        return [follow(v) for v in value['NS.objects']]
    if name['$classname'] == 'NSDate':
        return value['NS.time']
    content = {k: follow(v) if isinstance(v, plistlib.UID) else v for k, v in value.items()
               if k != '$class'}
    content['$class'] = name['$classes']
    return content

root = follow(archive['$top']['root'])
assert root['at'] == 60.0 and root['count'] == 70000
box = root['box']
assert box['name'] == 'Zürich' and box['open'] is True and box['next'] is None
assert [b['name'] for b in box['boxes']] == ['a', None]
assert box['boxes'][1]['$class'] == ['Crate', 'Box', 'NSObject']
)";
    EXPECT_TRUE(runs("python3 " + path("check.py") + " " + path("archive.plist")));
}

} // namespace
} // namespace orvo::NSKeyedArchiverTests
