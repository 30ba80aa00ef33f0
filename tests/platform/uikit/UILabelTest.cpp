#include "platform/uikit/UILabel.h"

#include "ViewTest.h"

namespace orvo {
namespace {

constexpr auto Horizontal = UILayoutConstraintAxis::Horizontal;
constexpr auto Vertical = UILayoutConstraintAxis::Vertical;

class LabelTest : public testing::ViewTest {
protected:
    static std::vector<std::string> shown(const std::shared_ptr<UILabel>& label) {
        std::vector<std::string> texts;
        for (const auto& line : label->_visibleLines().lines)
            texts.push_back(line.text);
        return texts;
    }
    static std::shared_ptr<NSAttributedString> styled(const std::string& text, double spacing) {
        const auto style = NSParagraphStyle::defaultParagraphStyle()->mutableCopy();
        style->setLineSpacing(spacing);
        return NSAttributedString::initWithString_attributes(
            text, {{NSParagraphStyleAttributeName, style}});
    }
    using Texts = std::vector<std::string>;
};

TEST_F(LabelTest, StartsAsOneNaturalLineWithoutText) {
    const auto text = UILabel::init();
    EXPECT_EQ(text->text(), std::nullopt);
    EXPECT_EQ(text->attributedText(), nullptr);
    EXPECT_EQ(text->numberOfLines(), 1);
    EXPECT_EQ(text->textAlignment(), NSTextAlignment::Natural);
    EXPECT_EQ(text->lineBreakMode(), NSLineBreakMode::ByTruncatingTail);
    EXPECT_TRUE(text->isAccessibilityElement());
}

TEST_F(LabelTest, IntrinsicSizeIsThatOfTheText) {
    const auto text = label(nullptr, "text", "four");
    EXPECT_EQ(text->intrinsicContentSize(), (CGSize{20, 10}));
    text->setText("one two");
    EXPECT_EQ(text->intrinsicContentSize(), (CGSize{35, 10}));
}

TEST_F(LabelTest, NoTextHasNoSizeAndAnEmptyOneTheHeightOfALine) {
    const auto text = label(nullptr, "text", "");
    EXPECT_EQ(text->intrinsicContentSize(), (CGSize{0, 10}));
    text->setText(std::nullopt);
    EXPECT_EQ(text->intrinsicContentSize(), (CGSize{0, 0}));
}

TEST_F(LabelTest, HeightFollowsFromTheWidthThatTheLayoutComesTo) {
    const auto card = root(40, 200);
    const auto text = label(card, "text", "one two three four");
    text->setNumberOfLines(0);
    const auto below = child(card, "below");
    activate({text->leadingAnchor().constraintEqualToAnchor(card->leadingAnchor()),
              text->trailingAnchor().constraintEqualToAnchor(card->trailingAnchor()),
              text->topAnchor().constraintEqualToAnchor(card->topAnchor()),
              below->topAnchor().constraintEqualToAnchor(text->bottomAnchor())});
    size(below, 5, 5);
    EXPECT_EQ(layout(card), R"(
UIView1 0 0 40 200
  text 0 0 40 30 "one two" "three" "four"
  below 0 30 5 5
)");
    card->setFrame({{0, 0}, {60, 200}});
    EXPECT_EQ(layout(card), R"(
UIView1 0 0 60 200
  text 0 0 60 20 "one two" "three four"
  below 0 20 5 5
)");
}

TEST_F(LabelTest, NumberOfLinesCapsAndCutsWithAnEllipsis) {
    const auto card = root(40, 200);
    const auto text = label(card, "text", "one two three four");
    text->setNumberOfLines(2);
    place(text, 0, 0);
    activate({text->widthAnchor().constraintEqualToConstant(40)});
    layout(card);
    EXPECT_EQ(frameOf(text).size.height, 20);
    EXPECT_EQ(shown(text), (Texts{"one two", "three f…"}));
}

TEST_F(LabelTest, OneLineIsCutAtItsWidth) {
    const auto card = root(40, 200);
    const auto text = label(card, "text", "one two three");
    place(text, 0, 0);
    activate({text->trailingAnchor().constraintLessThanOrEqualToAnchor(card->trailingAnchor())});
    layout(card);
    EXPECT_EQ(frameOf(text).size, (CGSize{40, 10}));
    EXPECT_EQ(shown(text), (Texts{"one two…"}));
}

TEST_F(LabelTest, PreferredWidthWrapsTheIntrinsicSize) {
    const auto text = label(nullptr, "text", "one two three");
    text->setNumberOfLines(0);
    text->setPreferredMaxLayoutWidth(40);
    EXPECT_EQ(text->intrinsicContentSize(), (CGSize{35, 20}));
}

TEST_F(LabelTest, HuggingAndCompressionDecideBetweenNeighbours) {
    const auto card = root(100, 10);
    const auto left = label(card, "left", "aaaaaaaaaaaa");   // 60 wide
    const auto right = label(card, "right", "bbbbbbbbbbbb"); // 60 wide
    activate({left->leadingAnchor().constraintEqualToAnchor(card->leadingAnchor()),
              right->leadingAnchor().constraintEqualToAnchor(left->trailingAnchor()),
              right->trailingAnchor().constraintEqualToAnchor(card->trailingAnchor())});
    left->setContentCompressionResistancePriority_forAxis(749, Horizontal);
    layout(card);
    EXPECT_EQ(frameOf(left).size.width, 40);
    EXPECT_EQ(frameOf(right).size.width, 60);
    left->setContentCompressionResistancePriority_forAxis(751, Horizontal);
    layout(card);
    EXPECT_EQ(frameOf(left).size.width, 60);
    left->setText("a");
    left->setContentHuggingPriority_forAxis(251, Horizontal);
    layout(card);
    EXPECT_EQ(frameOf(left).size.width, 5);
    EXPECT_EQ(frameOf(right).size.width, 95);
    left->setContentHuggingPriority_forAxis(249, Horizontal);
    layout(card);
    EXPECT_EQ(frameOf(left).size.width, 40);
    EXPECT_EQ(frameOf(right).size.width, 60);
}

TEST_F(LabelTest, BaselinesComeFromTheFont) {
    const auto card = root(100, 100);
    const auto text = label(card, "text", "one two");
    text->setNumberOfLines(0);
    const auto top = child(card, "top");
    const auto bottom = child(card, "bottom");
    place(text, 0, 20);
    activate({text->widthAnchor().constraintEqualToConstant(20),
              top->topAnchor().constraintEqualToAnchor(text->firstBaselineAnchor()),
              bottom->topAnchor().constraintEqualToAnchor(text->lastBaselineAnchor())});
    layout(card);
    EXPECT_EQ(frameOf(top).origin.y, 28);
    EXPECT_EQ(frameOf(bottom).origin.y, 38);
    text->setFont(UIFont::systemFontOfSize_weight(20, 400));
    layout(card);
    EXPECT_EQ(frameOf(top).origin.y, 36);
}

/// A title and a text in a row too low for both: the text gives way first.
class TightRowTest : public LabelTest {
protected:
    void make(CGFloat height, const std::string& titleText, const std::string& bodyText) {
        card = root(50, height);
        title = label(card, "title", titleText);
        body = label(card, "body", bodyText);
        for (const auto& each : {title, body}) {
            each->setNumberOfLines(0);
            activate({each->leadingAnchor().constraintEqualToAnchor(card->leadingAnchor()),
                      each->trailingAnchor().constraintEqualToAnchor(card->trailingAnchor())});
        }
        title->setContentCompressionResistancePriority_forAxis(749, Vertical);
        body->setContentCompressionResistancePriority_forAxis(748, Vertical);
        activate({title->topAnchor().constraintEqualToAnchor(card->topAnchor()),
                  body->topAnchor().constraintEqualToAnchor(title->bottomAnchor()),
                  body->bottomAnchor().constraintLessThanOrEqualToAnchor(card->bottomAnchor())});
    }
    std::shared_ptr<UIView> card;
    std::shared_ptr<UILabel> title;
    std::shared_ptr<UILabel> body;
};

TEST_F(TightRowTest, WeakerTextLosesWholeLinesAndEndsInAnEllipsis) {
    make(45, "Title", "one two three four five six seven eight");
    EXPECT_EQ(layout(card), R"(
UIView1 0 0 50 45
  title 0 0 50 10 "Title"
  body 0 10 50 30 "one two" "three four" "five six…"
)");
}

TEST_F(TightRowTest, WeakerTextGivesWayDownToOneLineThenTheStrongerOne) {
    make(34, "one two three four five six seven eight", "one two three four five");
    EXPECT_EQ(layout(card), R"(
UIView1 0 0 50 34
  title 0 0 50 20 "one two" "three fou…"
  body 0 20 50 10 "one two t…"
)");
    EXPECT_TRUE(log.messages().empty());
}

TEST_F(TightRowTest, LostLinesComeBackWithTheRoom) {
    make(25, "Title", "one two three four five six");
    layout(card);
    EXPECT_EQ(shown(body), (Texts{"one two t…"}));
    card->setFrame({{0, 0}, {50, 100}});
    layout(card);
    EXPECT_EQ(shown(body), (Texts{"one two", "three four", "five six"}));
}

TEST_F(TightRowTest, LastBaselineIsThatOfTheLastLineLeft) {
    make(45, "Title", "one two three four five six seven eight");
    const auto mark = child(card, "mark");
    activate({mark->topAnchor().constraintEqualToAnchor(body->lastBaselineAnchor())});
    layout(card);
    EXPECT_EQ(frameOf(mark).origin.y, 38);
}

TEST_F(LabelTest, AttributedTextBringsItsLineSpacing) {
    const auto text = label(nullptr, "text", "");
    text->setNumberOfLines(0);
    text->setPreferredMaxLayoutWidth(20);
    text->setAttributedText(styled("one two", 4));
    EXPECT_EQ(text->intrinsicContentSize(), (CGSize{15, 24}));
    EXPECT_EQ(text->text(), "one two");
}

TEST_F(LabelTest, PlainTextTakesTheAttributesAway) {
    const auto text = label(nullptr, "text", "");
    text->setNumberOfLines(0);
    text->setPreferredMaxLayoutWidth(20);
    text->setAttributedText(styled("one two", 4));
    text->setText("one two");
    EXPECT_EQ(text->intrinsicContentSize(), (CGSize{15, 20}));
}

TEST_F(LabelTest, FontAppliesToAttributedTextAsWell) {
    const auto text = label(nullptr, "text", "plain");
    text->setAttributedText(text->attributedText());
    text->setFont(UIFont::systemFontOfSize_weight(20, 400));
    EXPECT_EQ(text->intrinsicContentSize(), (CGSize{50, 20}));
}

TEST_F(LabelTest, AttributedTextIsKeptAsItWasGiven) {
    const auto text = label(nullptr, "text", "");
    const auto given = styled("one two", 4)->mutableCopy();
    text->setAttributedText(given);
    given->addAttribute_value_range(
        NSParagraphStyleAttributeName, NSParagraphStyle::defaultParagraphStyle(), {0, 7});
    EXPECT_TRUE(text->attributedText()->isEqual(styled("one two", 4).get()));
}

TEST_F(LabelTest, SameTextAndFontAreNotMeasuredAgain) {
    const auto text = label(nullptr, "text", "one two");
    std::ignore = text->intrinsicContentSize();
    const auto before = UILabel::_measurements();
    text->setText("one two");
    text->setFont(UIFont::systemFontOfSize_weight(10, 400));
    std::ignore = text->intrinsicContentSize();
    EXPECT_EQ(UILabel::_measurements(), before);
    text->setText("two one");
    std::ignore = text->intrinsicContentSize();
    EXPECT_EQ(UILabel::_measurements(), before + 1);
}

TEST_F(LabelTest, ShowsNothingWithoutRoom) {
    const auto text = label(nullptr, "text", "one");
    text->setFrame({{0, 0}, {50, 0}});
    EXPECT_TRUE(shown(text).empty());
    text->setFrame({{0, 0}, {50, 10}});
    EXPECT_EQ(shown(text), (Texts{"one"}));
}

TEST_F(LabelTest, RoundedEdgesCostNoLineAndNoWord) {
    const auto card = root(100, 100);
    const auto text = label(card, "text", "abc def");
    text->setNumberOfLines(0);
    place(text, 0.4, 0.45); // 35 wide, 10 high: at 1x the edges are 0, 35, 0, 10
    layout(card);
    EXPECT_EQ(shown(text), (Texts{"abc def"}));
    const auto fraction = label(card, "fraction", "abc def", 10.2);
    fraction->setNumberOfLines(0);
    place(fraction, 0.4, 40); // 35.7 wide, 10.2 high; rounded 36 and 10
    layout(card);
    EXPECT_EQ(frameOf(fraction).size.height, 10);
    EXPECT_EQ(shown(fraction), (Texts{"abc def"}));
}

TEST_F(LabelTest, FrameRoundedByHandCostsNoLineEither) {
    const auto text = label(nullptr, "text", "one two", 10.4);
    text->setNumberOfLines(0);
    text->setFrame({{0, 0}, {21, 20}}); // two lines of 10.4
    EXPECT_EQ(shown(text), (Texts{"one", "two"}));
    text->setFrame({{0, 0}, {21, 15}});
    EXPECT_EQ(shown(text), (Texts{"one\u2026"}));
}

TEST_F(LabelTest, SpeaksItsTextUnlessToldOtherwise) {
    const auto text = label(nullptr, "text", "Line 4");
    EXPECT_EQ(text->accessibilityLabel(), "Line 4");
    text->setAccessibilityLabel("Line four");
    EXPECT_EQ(text->accessibilityLabel(), "Line four");
}

} // namespace
} // namespace orvo
