#include "platform/foundation/NSKeyedUnarchiver.h"

#include "platform/foundation/Exceptions.h"
#include "platform/foundation/KeyedArchiveSupport.h"
#include "platform/foundation/NSDate.h"
#include "platform/foundation/NSMutableSet.h"
#include "platform/foundation/NSOrderedSet.h"
#include "platform/foundation/NSURL.h"

#include <gtest/gtest.h>

namespace orvo::NSKeyedUnarchiverTests {
namespace {

using testing::Box;
using testing::Crate;
using testing::Loose;
using Hand = testing::HandMadeArchive;
using Names = std::vector<std::string>;

const Names& everything() {
    static const Names names{"NSObject"};
    return names;
}

class NSKeyedUnarchiverTest : public ::testing::Test {
protected:
    static std::shared_ptr<NSData> archived(const std::shared_ptr<NSObject>& root,
                                            bool secure = true) {
        return NSKeyedArchiver::archivedDataWithRootObject_requiringSecureCoding_error(root,
                                                                                       secure);
    }
    /// The root; fails the test for an error.
    static std::shared_ptr<NSObject> decode(const std::shared_ptr<NSData>& data,
                                            const Names& classes = everything()) {
        std::shared_ptr<NSError> error;
        auto object =
            NSKeyedUnarchiver::unarchivedObjectOfClasses_fromData_error(classes, data, &error);
        EXPECT_FALSE(error) << descriptionOf(error);
        return object;
    }
    /// What is wrong with the archive; checks domain and code.
    static std::string failure(const std::shared_ptr<NSData>& data,
                               const Names& classes = everything()) {
        std::shared_ptr<NSError> error;
        EXPECT_FALSE(
            NSKeyedUnarchiver::unarchivedObjectOfClasses_fromData_error(classes, data, &error));
        if (!error)
            return "(no error)";
        EXPECT_EQ(error->domain(), NSCocoaErrorDomain);
        EXPECT_EQ(error->code(), NSCoderReadCorruptError);
        return error->localizedDescription().substr(std::string("keyed archive: ").size());
    }
    static std::shared_ptr<NSObject> text(const char* utf8) { return NSString::string(utf8); }

private:
    EnvironmentSlot<std::shared_ptr<const CodingClassTable>>::Override _classes =
        CodingClassTable::current().overrideWith(testing::boxClasses());
};

TEST_F(NSKeyedUnarchiverTest, EveryClassOfFoundationComesBackEqual) {
    const auto set = NSMutableSet::set();
    set->addObject(text("s"));
    const std::vector<std::shared_ptr<NSObject>> objects{
        text("Zürich 🚇"),
        text("$null"),
        NSNumber::numberWithBool(true),
        NSNumber::numberWithInteger(-3),
        NSNumber::numberWithDouble(0.1),
        NSNumber::numberWithUnsignedInteger(UINT64_MAX),
        NSData::dataWithString("bytes"),
        NSDate::dateWithTimeIntervalSinceReferenceDate(0.5),
        NSURL::URLWithString("orvo://?t=r"),
        NSArray::arrayWithObjects({text("a"), text("a"), NSArray::array()}),
        NSDictionary::dictionaryWithEntries({{NSNumber::numberWithInteger(1), text("one")}}),
        NSOrderedSet::orderedSetWithObjects({text("b"), text("a")}),
        NSOrderedSet::orderedSet(),
        set,
        NSError::errorWithDomain_code_userInfo(
            "D",
            -1,
            NSDictionary::dictionaryWithTextKeys(
                {{NSUnderlyingErrorKey, NSError::errorWithMessage("E", 2, "inner")}})),
        NSError::errorWithDomain_code_userInfo("D", 1, nullptr),
    };
    for (const auto& object : objects)
        EXPECT_TRUE(equal(decode(archived(object)), object)) << object->description();
    EXPECT_EQ(decode(archived(nullptr)), nullptr);
}

TEST_F(NSKeyedUnarchiverTest, ObjectsComeBackWithAllTheyHold) {
    const auto box = Box::boxNamed("outer");
    box->isOpen = true;
    box->weight = -40;
    box->height = 1.25;
    box->boxes = NSArray::arrayOf<Box>({Box::boxNamed("a"), Box::boxNamed("b")});
    box->next = Box::boxNamed("next");
    EXPECT_TRUE(equal(decode(archived(box), {"Box"}), box));
}

TEST_F(NSKeyedUnarchiverTest, ASharedObjectIsDecodedOnce) {
    const auto shared = Box::boxNamed("shared");
    const auto outer = Box::boxNamed("outer");
    outer->boxes = NSArray::arrayOf<Box>({shared, shared});
    outer->next = shared;
    const auto back = std::dynamic_pointer_cast<Box>(decode(archived(outer), {"Box"}));
    ASSERT_TRUE(back);
    EXPECT_EQ(back->boxes->objectAtIndex(0), back->boxes->objectAtIndex(1));
    EXPECT_EQ(back->boxes->objectAtIndex(0), back->next);
}

TEST_F(NSKeyedUnarchiverTest, AClassIsAllowedWithWhatDerivesFromIt) {
    const auto back = decode(archived(std::make_shared<Crate>()), {"Box"});
    EXPECT_TRUE(std::dynamic_pointer_cast<Crate>(back));
    EXPECT_EQ(failure(archived(Box::boxNamed("x")), {"Crate"}),
              "object 1 is of the class Box, which is not allowed there");
}

TEST_F(NSKeyedUnarchiverTest, TheArchivesOwnWordOnWhatAClassDerivesFromCountsForNothing) {
    const auto liar = NSDictionary::dictionaryWithTextKeys(
        {{"$classname", text("Box")},
         {"$classes",
          NSArray::arrayWithObjects({text("Box"), text("NSArray"), text("NSObject")})}});
    EXPECT_EQ(failure(Hand::data({Hand::object(2, {}), liar}), {"NSArray"}),
              "object 1 is of the class Box, which is not allowed there");
}

TEST_F(NSKeyedUnarchiverTest, OnlyAllowedClassesAtEveryDepth) {
    const auto boxes = NSArray::arrayOf<Box>({Box::boxNamed("x")});
    EXPECT_TRUE(decode(archived(boxes), {"NSArray", "Box"}));
    EXPECT_EQ(failure(archived(boxes), {"NSArray"}),
              "object 2 is of the class Box, which is not allowed there");
    const auto nested = NSArray::arrayOf<NSArray>(
        {NSArray::arrayWithObjects({NSDictionary::dictionaryWithTextKeys({{"k", text("v")}})})});
    EXPECT_TRUE(decode(archived(nested), {"NSArray", "NSDictionary", "NSString"}));
    EXPECT_EQ(failure(archived(nested), {"NSArray", "NSString"}),
              "object 3 is of the class NSDictionary, which is not allowed there");
    EXPECT_EQ(failure(archived(nested), {"NSArray", "NSDictionary"}),
              "object 4 is of the class NSString, which is not allowed there");
    EXPECT_EQ(failure(archived(text("x")), {}),
              "object 1 is of the class NSString, which is not allowed there");

    const auto box = Box::boxNamed("x"); // its class names other classes for these
    box->boxes = NSArray::arrayWithObjects({text("no box")});
    EXPECT_EQ(failure(archived(box)),
              "object 4 is of the class NSString, which is not allowed there");
}

TEST_F(NSKeyedUnarchiverTest, ACollectionMetAgainIsHeldAgainstTheClassesAllowedThere) {
    // The same array as an element, where anything goes, and as a box's boxes, where texts do not.
    const auto list = NSArray::arrayWithObjects({text("no box")});
    const auto box = Box::boxNamed("x");
    box->boxes = list;
    const auto both = NSArray::arrayWithObjects({list, box});
    EXPECT_EQ(failure(archived(both)),
              "object 3 is of the class NSString, which is not allowed there");
}

TEST_F(NSKeyedUnarchiverTest, AnErrorsUserInfoHoldsOnlyValues) {
    const auto withInfo = [&](const std::shared_ptr<NSObject>& value) {
        return archived(NSError::errorWithDomain_code_userInfo(
            "D", 1, NSDictionary::dictionaryWithTextKeys({{"k", value}})));
    };
    EXPECT_TRUE(decode(withInfo(NSURL::URLWithString("a:b")), {"NSError"}));
    EXPECT_EQ(failure(withInfo(Box::boxNamed("x")), {"NSError"}),
              "object 5 is of the class Box, which is not allowed there");
}

TEST_F(NSKeyedUnarchiverTest, WithoutSecureCodingAnyKnownClassIsMade) {
    const auto loose = std::make_shared<Loose>();
    loose->content = Box::boxNamed("x");
    const auto data = archived(loose, false);
    EXPECT_EQ(failure(data), "object 1 is of the class Loose, which is not allowed there");
    const auto unarchiver = NSKeyedUnarchiver::initForReadingFromData_error(data);
    unarchiver->setRequiresSecureCoding(false);
    const auto back = std::dynamic_pointer_cast<Loose>(unarchiver->decodeObjectForKey("root"));
    ASSERT_TRUE(back);
    EXPECT_TRUE(equal(back->content, loose->content));
}

TEST_F(NSKeyedUnarchiverTest, WithoutNamedClassesOnlyPropertyListsAreMade) {
    const auto root = [](const std::shared_ptr<NSObject>& object) {
        return NSKeyedUnarchiver::initForReadingFromData_error(archived(object))
            ->decodeObjectForKey("root");
    };
    EXPECT_TRUE(root(NSArray::arrayWithObjects({text("a")})));
    EXPECT_FALSE(root(Box::boxNamed("x")));
    EXPECT_FALSE(root(NSArray::arrayOf<Box>({Box::boxNamed("x")})));
}

TEST_F(NSKeyedUnarchiverTest, AnUnknownClassIsAnError) {
    EXPECT_EQ(failure(Hand::data({Hand::object(2, {}), Hand::classNamed("Barrel")})),
              "the class Barrel is not known");
}

TEST_F(NSKeyedUnarchiverTest, AnotherClassCanStandForAnArchivedName) {
    const auto data = Hand::data(
        {Hand::object(2, {{"name", Hand::reference(3)}}), Hand::classNamed("OldBox"), text("x")});
    const auto unarchiver = NSKeyedUnarchiver::initForReadingFromData_error(data);
    unarchiver->setClass_forClassName("Box", "OldBox");
    std::shared_ptr<NSError> error;
    const auto box = std::dynamic_pointer_cast<Box>(
        unarchiver->decodeTopLevelObjectOfClasses_forKey_error({"Box"}, "root", &error));
    ASSERT_TRUE(box) << descriptionOf(error);
    EXPECT_EQ(box->name, "x");
}

TEST_F(NSKeyedUnarchiverTest, AClassThatAnswersNilGivesNilWithoutAnError) {
    EXPECT_FALSE(decode(archived(Box::boxNamed("none")), {"Box"}));
    const auto holder = Box::boxNamed("holder");
    holder->next = Box::boxNamed("none");
    const auto back = std::dynamic_pointer_cast<Box>(decode(archived(holder), {"Box"}));
    ASSERT_TRUE(back);
    EXPECT_FALSE(back->next);
    EXPECT_EQ(failure(archived(NSArray::arrayOf<Box>({Box::boxNamed("none")}))),
              "an element under the key NS.objects is nil");
}

TEST_F(NSKeyedUnarchiverTest, TheFailurePolicyDecidesWhetherAFailureRaises) {
    const auto data = archived(Box::boxNamed("x"));
    const auto quiet = NSKeyedUnarchiver::initForReadingFromData_error(data);
    EXPECT_EQ(quiet->decodingFailurePolicy(), NSDecodingFailurePolicy::SetErrorAndReturn);
    EXPECT_FALSE(quiet->decodeObjectOfClass_forKey("NSArray", "root"));
    ASSERT_TRUE(quiet->error());
    EXPECT_EQ(quiet->error()->code(), 4864);
    EXPECT_FALSE(quiet->decodeObjectOfClass_forKey("Box", "root")); // nothing after a failure
    EXPECT_FALSE(quiet->containsValueForKey("root"));

    const auto loud = NSKeyedUnarchiver::initForReadingFromData_error(data);
    loud->setDecodingFailurePolicy(NSDecodingFailurePolicy::RaiseException);
    EXPECT_THROW((void)loud->decodeObjectOfClass_forKey("NSArray", "root"),
                 NSInvalidUnarchiveOperationException);

    const auto topLevel = NSKeyedUnarchiver::initForReadingFromData_error(data);
    topLevel->setDecodingFailurePolicy(NSDecodingFailurePolicy::RaiseException);
    std::shared_ptr<NSError> error;
    EXPECT_FALSE(topLevel->decodeTopLevelObjectOfClasses_forKey_error({"NSArray"}, "root", &error));
    ASSERT_TRUE(error);
    EXPECT_EQ(topLevel->decodingFailurePolicy(), NSDecodingFailurePolicy::RaiseException);
}

TEST_F(NSKeyedUnarchiverTest, NothingUnderTheKeyIsAnErrorOnlyAtTheTop) {
    const auto unarchiver =
        NSKeyedUnarchiver::initForReadingFromData_error(archived(Box::boxNamed("x")));
    EXPECT_FALSE(unarchiver->decodeObjectOfClass_forKey("Box", "other"));
    EXPECT_EQ(unarchiver->decodeIntegerForKey("other"), 0);
    EXPECT_FALSE(unarchiver->error());
    std::shared_ptr<NSError> error;
    EXPECT_FALSE(unarchiver->decodeTopLevelObjectOfClasses_forKey_error({"Box"}, "other", &error));
    ASSERT_TRUE(error);
    EXPECT_EQ(error->code(), NSCoderValueNotFoundError);
}

TEST_F(NSKeyedUnarchiverTest, AfterTheEndThereIsNothing) {
    const auto unarchiver =
        NSKeyedUnarchiver::initForReadingFromData_error(archived(Box::boxNamed("x")));
    unarchiver->finishDecoding();
    EXPECT_FALSE(unarchiver->containsValueForKey("root"));
    EXPECT_FALSE(unarchiver->decodeObjectOfClass_forKey("Box", "root"));
    EXPECT_THROW(unarchiver->encodeBool_forKey(true, "x"), NSInvalidArgumentException);
}

TEST_F(NSKeyedUnarchiverTest, NilIsContainedAndIsNil) {
    const auto archiver = NSKeyedArchiver::initRequiringSecureCoding(true);
    archiver->encodeObject_forKey(nullptr, "nil");
    const auto unarchiver =
        NSKeyedUnarchiver::initForReadingFromData_error(archiver->encodedData());
    EXPECT_TRUE(unarchiver->containsValueForKey("nil"));
    EXPECT_FALSE(unarchiver->decodeObjectOfClass_forKey("Box", "nil"));
    EXPECT_FALSE(unarchiver->containsValueForKey("other"));
    EXPECT_FALSE(unarchiver->error());
}

TEST_F(NSKeyedUnarchiverTest, WhatIsNoArchiveCannotBeOpened) {
    const auto opened = [](const std::shared_ptr<NSData>& data) {
        std::shared_ptr<NSError> error;
        const auto unarchiver = NSKeyedUnarchiver::initForReadingFromData_error(data, &error);
        EXPECT_NE(unarchiver == nullptr, error == nullptr);
        return error ? error->localizedDescription() : "opened";
    };
    EXPECT_EQ(opened(nullptr), "keyed archive: there is no data");
    EXPECT_EQ(opened(NSData::dataWithString("junk")),
              "keyed archive: the bytes are no property list");
    EXPECT_EQ(opened(PropertyList::write(*NSArray::array())),
              "keyed archive: the property list is no keyed archive");
    const auto changed = [&](const char* key, const std::shared_ptr<NSObject>& value) {
        auto entries = Hand::list({text("x")})->entries();
        entries.emplace_back(NSString::string(key), value);
        return opened(
            PropertyList::write(*NSDictionary::dictionaryWithEntries(std::move(entries))));
    };
    EXPECT_EQ(changed("other", text("x")), "opened");
    EXPECT_EQ(changed("$archiver", text("other")),
              "keyed archive: the property list is no keyed archive");
    EXPECT_EQ(changed("$version", NSNumber::numberWithInteger(1)),
              "keyed archive: the archive is of an unknown version");
    EXPECT_EQ(changed("$version", text("100000")),
              "keyed archive: the archive is of an unknown version");
    for (const auto& objects : {NSArray::array(), NSArray::arrayWithObjects({text("x")})})
        EXPECT_EQ(changed("$objects", objects), "keyed archive: the archive has no objects");
    EXPECT_EQ(changed("$objects", text("x")), "keyed archive: the archive has no objects");
    EXPECT_EQ(changed("$top", text("x")), "keyed archive: the archive has no objects");
}

TEST_F(NSKeyedUnarchiverTest, AnUnopenedArchiveSaysWhyInItsUnderlyingError) {
    std::shared_ptr<NSError> error;
    EXPECT_FALSE(
        NSKeyedUnarchiver::initForReadingFromData_error(NSData::dataWithString("junk"), &error));
    const auto underlying =
        std::dynamic_pointer_cast<NSError>(error->userInfo()->objectForKey(NSUnderlyingErrorKey));
    ASSERT_TRUE(underlying);
    EXPECT_EQ(underlying->domain(), PropertyList::ErrorDomain);
}

TEST_F(NSKeyedUnarchiverTest, ReferencesPastTheEndAreErrors) {
    EXPECT_EQ(failure(Hand::data({})), "there is no object 1");
    EXPECT_EQ(failure(Hand::data({Hand::object(2, {{"NS.objects", Hand::references({70})}}),
                                  Hand::classNamed("NSArray")})),
              "there is no object 70");
    EXPECT_EQ(failure(Hand::data({Hand::object(UINT64_MAX, {})})), "an object has no class");
}

TEST_F(NSKeyedUnarchiverTest, CirclesAreErrors) {
    EXPECT_EQ(failure(Hand::data({Hand::object(2, {{"NS.objects", Hand::references({1})}}),
                                  Hand::classNamed("NSArray")})),
              "object 1 contains itself");
    EXPECT_EQ(failure(Hand::data({Hand::object(2, {{"next", Hand::reference(3)}}),
                                  Hand::classNamed("Box"),
                                  Hand::object(2, {{"next", Hand::reference(1)}})})),
              "object 1 contains itself");
}

TEST_F(NSKeyedUnarchiverTest, WrongTypesAreErrors) {
    const auto ofClass = [](const char* name, Hand::Entries entries) {
        return failure(
            Hand::data({Hand::object(2, std::move(entries)), Hand::classNamed(name), text("x")}));
    };
    EXPECT_EQ(ofClass("NSArray", {}), "there is no list under the key NS.objects");
    EXPECT_EQ(ofClass("NSArray", {{"NS.objects", text("x")}}),
              "there is no list under the key NS.objects");
    EXPECT_EQ(ofClass("NSArray", {{"NS.objects", NSArray::arrayWithObjects({text("x")})}}),
              "a value stands where a reference should");
    EXPECT_EQ(ofClass("NSArray", {{"NS.objects", Hand::references({0})}}),
              "an element under the key NS.objects is nil");
    EXPECT_EQ(ofClass("NSDictionary",
                      {{"NS.keys", Hand::references({3})}, {"NS.objects", Hand::references({})}}),
              "a dictionary whose keys and values do not fit");
    EXPECT_EQ(ofClass("NSDate", {}), "a date without a time");
    EXPECT_EQ(ofClass("NSDate", {{"NS.time", text("x")}}), "a date without a time");
    EXPECT_EQ(ofClass("NSURL", {{"NS.relative", Hand::reference(3)}}),
              "a URL that is none, or is relative to another");
    EXPECT_EQ(ofClass("NSError", {{"NSCode", NSNumber::numberWithInteger(1)}}),
              "an error without a domain, or with another user info");
    EXPECT_EQ(
        ofClass("NSError", {{"NSDomain", Hand::reference(3)}, {"NSUserInfo", Hand::reference(3)}}),
        "an error without a domain, or with another user info");
    EXPECT_EQ(ofClass("NSOrderedSet", {{"NS.object.0", Hand::reference(0)}}),
              "the element NS.object.0 is nil");
    EXPECT_EQ(ofClass("NSNumber", {}), "a number that is none");
    EXPECT_EQ(ofClass("NSMutableString", {}), "a string without text");
    EXPECT_EQ(ofClass("NSMutableData", {{"NS.data", text("x")}}), "data without bytes");
    EXPECT_EQ(ofClass("Box", {{"name", text("x")}}), "a value stands where a reference should");
    EXPECT_EQ(ofClass("Box", {{"open", text("x")}}), "the value under the key open is no number");
    EXPECT_EQ(ofClass("Box", {{"weight", Hand::reference(3)}}),
              "the value under the key weight is no number");
}

TEST_F(NSKeyedUnarchiverTest, ObjectsWithoutAProperClassAreErrors) {
    const auto error = [](NSArray::Elements objects) {
        return failure(Hand::data(std::move(objects)));
    };
    EXPECT_EQ(error({NSDictionary::dictionary()}), "an object has no class");
    EXPECT_EQ(error({NSArray::array()}), "an object has no class");
    EXPECT_EQ(error({Hand::reference(1)}), "an object has no class");
    EXPECT_EQ(error({NSDate::dateWithTimeIntervalSinceReferenceDate(0)}), "an object has no class");
    EXPECT_EQ(error({Hand::object(0, {})}), "an object has no class");
    EXPECT_EQ(error({Hand::object(2, {}), text("Box")}), "an object has no class");
    EXPECT_EQ(error({Hand::object(2, {}), NSDictionary::dictionary()}), "an object has no class");
}

TEST_F(NSKeyedUnarchiverTest, KindsThatCanChangeAreReadToo) {
    const auto read = [](const char* name, Hand::Entries entries) {
        return decode(
            Hand::data({Hand::object(2, std::move(entries)), Hand::classNamed(name), text("x")}));
    };
    EXPECT_TRUE(equal(read("NSMutableString", {{"NS.string", text("m")}}), text("m")));
    EXPECT_TRUE(equal(read("NSMutableData", {{"NS.data", NSData::dataWithString("m")}}),
                      NSData::dataWithString("m")));
    EXPECT_TRUE(equal(read("NSMutableArray", {{"NS.objects", Hand::references({3})}}),
                      NSArray::arrayWithObjects({text("x")})));
    EXPECT_TRUE(
        equal(read("NSMutableDictionary",
                   {{"NS.keys", Hand::references({3})}, {"NS.objects", Hand::references({3})}}),
              NSDictionary::dictionaryWithTextKeys({{"x", text("x")}})));
    for (const char* name : {"NSSet", "NSOrderedSet", "NSMutableOrderedSet"})
        EXPECT_TRUE(equal(read(name, {{"NS.objects", Hand::references({3, 3})}}),
                          NSOrderedSet::orderedSetWithObjects({text("x")})))
            << name;
}

TEST_F(NSKeyedUnarchiverTest, DepthHasALimit) {
    const auto chain = [](std::uint64_t length) {
        NSArray::Elements objects;
        for (std::uint64_t i = 1; i < length; ++i)
            objects.push_back(Hand::object(length + 1, {{"next", Hand::reference(i + 1)}}));
        objects.push_back(Hand::object(length + 1, {}));
        objects.push_back(Hand::classNamed("Box"));
        return Hand::data(std::move(objects));
    };
    EXPECT_TRUE(decode(chain(KeyedArchive::MaximumDepth)));
    EXPECT_EQ(failure(chain(KeyedArchive::MaximumDepth + 1)), "the objects are nested too deep");
    EXPECT_EQ(failure(chain(10'000)), "the objects are nested too deep");
}

TEST_F(NSKeyedUnarchiverTest, DepthIsCountedThroughSharedObjects) {
    // The root's elements, innermost first, so that each finds what it holds already decoded.
    constexpr std::uint64_t length = 1000;
    std::vector<std::uint64_t> elements;
    NSArray::Elements objects{nullptr, Hand::classNamed("NSArray")};
    for (std::uint64_t i = 0; i < length; ++i) {
        elements.push_back(3 + i);
        objects.push_back(Hand::object(
            2, {{"NS.objects", i == 0 ? Hand::references({}) : Hand::references({2 + i})}}));
    }
    objects[0] = Hand::object(2, {{"NS.objects", Hand::references(elements)}});
    EXPECT_EQ(failure(Hand::data(std::move(objects))),
              "the objects are nested too deep, or unfold to too many");
}

TEST_F(NSKeyedUnarchiverTest, SharedObjectsThatUnfoldWithoutEndAreErrors) {
    NSArray::Elements objects;
    constexpr std::uint64_t levels = 40;
    for (std::uint64_t i = 1; i < levels; ++i)
        objects.push_back(
            Hand::object(levels + 1, {{"NS.objects", Hand::references({i + 1, i + 1})}}));
    objects.push_back(Hand::object(levels + 1, {{"NS.objects", Hand::references({})}}));
    objects.push_back(Hand::classNamed("NSArray"));
    EXPECT_EQ(failure(Hand::data(std::move(objects))),
              "the objects are nested too deep, or unfold to too many");
}

TEST_F(NSKeyedUnarchiverTest, ALongKeyOfManyDictionariesIsAnError) {
    constexpr std::uint64_t count = 1000;
    std::vector<std::uint64_t> elements;
    NSArray::Elements objects{nullptr,
                              Hand::classNamed("NSArray"),
                              Hand::classNamed("NSDictionary"),
                              NSString::string(std::string(100'000, 'k'))};
    for (std::uint64_t i = 0; i < count; ++i) {
        elements.push_back(5 + i);
        objects.push_back(Hand::object(
            3, {{"NS.keys", Hand::references({4})}, {"NS.objects", Hand::references({4})}}));
    }
    objects[0] = Hand::object(2, {{"NS.objects", Hand::references(elements)}});
    EXPECT_EQ(failure(Hand::data(std::move(objects))), "too much is to be found by content");
}

TEST_F(NSKeyedUnarchiverTest, ASetOfManyElementsWithOneHashIsAnError) {
    // Errors hash by domain and code alone.
    const auto set = [](std::uint64_t count) {
        std::vector<std::uint64_t> elements;
        NSArray::Elements objects{nullptr,
                                  Hand::classNamed("NSSet"),
                                  Hand::classNamed("NSError"),
                                  text("D"),
                                  Hand::classNamed("NSDictionary")};
        for (std::uint64_t i = 0; i < count; ++i) {
            const auto number = objects.size() + 1;
            elements.push_back(number);
            objects.push_back(Hand::object(
                3,
                {{"NSDomain", Hand::reference(4)}, {"NSUserInfo", Hand::reference(number + 1)}}));
            objects.push_back(Hand::object(5,
                                           {{"NS.keys", Hand::references({4})},
                                            {"NS.objects", Hand::references({number + 2})}}));
            objects.push_back(NSNumber::numberWithUnsignedInteger(i));
        }
        objects[0] = Hand::object(2, {{"NS.objects", Hand::references(elements)}});
        return Hand::data(std::move(objects));
    };
    EXPECT_TRUE(decode(set(50)));
    EXPECT_EQ(failure(set(5000)), "a set of too many elements with one hash");
}

TEST_F(NSKeyedUnarchiverTest, AnyByteChangedNeverHarms) {
    const auto box = Box::boxNamed("outer");
    box->boxes = NSArray::arrayOf<Box>({Box::boxNamed("a"), Box::boxNamed("b")});
    const auto whole = archived(NSArray::arrayWithObjects(
        {box, NSError::errorWithMessage("D", 1, "m"), NSURL::URLWithString("a:b")}));
    for (std::size_t i = 0; i < whole->length(); ++i)
        for (const unsigned mask : {0x01U, 0x80U, 0xFFU}) {
            std::vector<std::uint8_t> bytes(whole->bytes().begin(), whole->bytes().end());
            bytes[i] = static_cast<std::uint8_t>(bytes[i] ^ mask);
            std::shared_ptr<NSError> error;
            const auto object = NSKeyedUnarchiver::unarchivedObjectOfClasses_fromData_error(
                everything(), NSData::dataWithVector(bytes), &error);
            EXPECT_FALSE(object && error);
        }
}

TEST_F(NSKeyedUnarchiverTest, CutAnywhereItCannotBeOpened) {
    const auto whole = archived(Box::boxNamed("x"));
    for (std::size_t length = 0; length < whole->length(); ++length)
        EXPECT_FALSE(NSKeyedUnarchiver::initForReadingFromData_error(
            NSData::dataWithBytes(whole->bytes().first(length))))
            << length;
}

} // namespace
} // namespace orvo::NSKeyedUnarchiverTests
