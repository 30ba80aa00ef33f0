#include "platform/favorites/TransitStorageArtwork.h"

#include "platform/foundation/NSArray.h"
#include "platform/foundation/NSString.h"
#include "platform/geoservices/ServerFormatToken.h"

namespace orvo {

namespace {

// Field numbers, of each message in the order of its record's fields.
enum Artwork : std::uint32_t {
    SourceType = 1,
    UseType,
    Shield,
    Icon,
    FallbackShield,
    TextSource,
    Badge,
    Accessibility
};
enum ShieldField : std::uint32_t { ShieldType = 1, ShieldText, ShieldColor };
enum IconField : std::uint32_t {
    IconType = 1,
    CartoID,
    DefaultTransitType,
    AttributeKey,
    AttributeValue
};
enum TextField : std::uint32_t { Formats = 1, Separators, Tokens, Alternative };
enum TokenField : std::uint32_t { TokenType = 1, TokenName, TokenText, TokenValue };

void writeText(ProtoWriter& writer, std::uint32_t number, const std::optional<std::string>& text) {
    if (text)
        writer.writeString(number, *text);
}

void writeTexts(ProtoWriter& writer, std::uint32_t number, const std::shared_ptr<NSArray>& texts) {
    for (const auto& text : typed<NSString>(texts))
        writer.writeString(number, text->utf8());
}

ProtoWriter encode(const TransitShieldDataSource& shield) {
    ProtoWriter writer;
    writer.writeInt32(ShieldType, shield.shieldType());
    writeText(writer, ShieldText, shield.shieldText());
    writeText(writer, ShieldColor, shield.shieldColorString());
    return writer;
}

ProtoWriter encode(const TransitIconDataSource& icon) {
    ProtoWriter writer;
    writer.writeInt32(IconType, icon.iconType());
    writer.writeUInt32(CartoID, icon.cartoID());
    writer.writeUInt32(DefaultTransitType, icon.defaultTransitType());
    writer.writeUInt32(AttributeKey, icon.iconAttributeKey());
    writer.writeUInt32(AttributeValue, icon.iconAttributeValue());
    return writer;
}

ProtoWriter encode(const ServerFormatToken& token) {
    ProtoWriter writer;
    writer.writeInt32(TokenType, token.type());
    writeText(writer, TokenName, token.token());
    writeText(writer, TokenText, token.text());
    writer.writeDouble(TokenValue, token.value());
    return writer;
}

ProtoWriter encode(const TransitTextDataSource& source) {
    ProtoWriter writer;
    const auto text = source.text();
    if (!text)
        return writer;
    ProtoWriter formatted;
    writeTexts(formatted, Formats, text->formatStrings());
    writeTexts(formatted, Separators, text->separators());
    for (const auto& token : typed<ServerFormatToken>(text->formatTokens()))
        formatted.writeBytes(Tokens, encode(*token).bytes());
    writeText(formatted, Alternative, text->alternativeString());
    writer.writeBytes(1, formatted.bytes());
    return writer;
}

template <class Record>
void writeRecord(ProtoWriter& writer, std::uint32_t number, const std::shared_ptr<Record>& record) {
    if (record)
        writer.writeBytes(number, encode(*record).bytes());
}

/// Walks a message's fields; `take` reads the value of a field that it knows and answers whether it
/// did.
template <class Take>
void walk(ProtoReader& reader, Take&& take) {
    while (!reader.isAtEnd()) {
        const auto tag = reader.readTag();
        if (reader.hasError() || tag.wireType == ProtoWireType::EndGroup)
            return;
        if (!take(tag))
            reader.skip(tag);
    }
}

template <class Take>
void walkSubMessage(ProtoReader& reader, Take&& take) {
    ProtoReader::Mark mark;
    if (!reader.placeMark(mark))
        return;
    walk(reader, take);
    reader.recallMark(mark);
}

constexpr bool isVarint(ProtoTag tag) {
    return tag.wireType == ProtoWireType::Varint;
}
constexpr bool isBytes(ProtoTag tag) {
    return tag.wireType == ProtoWireType::LengthDelimited;
}

template <class Number>
Number number(ProtoReader& reader) {
    return static_cast<Number>(reader.readVarint());
}

std::shared_ptr<TransitShieldDataSource> readShield(ProtoReader& reader) {
    TransitShieldDataSource::Fields fields;
    walkSubMessage(reader, [&](ProtoTag tag) {
        if (tag.fieldNumber == ShieldType && isVarint(tag))
            fields.shieldType = number<std::int32_t>(reader);
        else if (tag.fieldNumber == ShieldText && isBytes(tag))
            fields.shieldText = reader.readString();
        else if (tag.fieldNumber == ShieldColor && isBytes(tag))
            fields.shieldColorString = reader.readString();
        else
            return false;
        return true;
    });
    return TransitShieldDataSource::initWithFields(std::move(fields));
}

std::shared_ptr<TransitIconDataSource> readIcon(ProtoReader& reader) {
    TransitIconDataSource::Fields fields;
    walkSubMessage(reader, [&](ProtoTag tag) {
        if (!isVarint(tag))
            return false;
        switch (tag.fieldNumber) {
        case IconType:
            fields.iconType = number<std::int32_t>(reader);
            return true;
        case CartoID:
            fields.cartoID = number<std::uint32_t>(reader);
            return true;
        case DefaultTransitType:
            fields.defaultTransitType = number<std::uint32_t>(reader);
            return true;
        case AttributeKey:
            fields.iconAttributeKey = number<std::uint32_t>(reader);
            return true;
        case AttributeValue:
            fields.iconAttributeValue = number<std::uint32_t>(reader);
            return true;
        default:
            return false;
        }
    });
    return TransitIconDataSource::initWithFields(fields);
}

std::shared_ptr<ServerFormatToken> readToken(ProtoReader& reader) {
    ServerFormatToken::Fields fields;
    walkSubMessage(reader, [&](ProtoTag tag) {
        if (tag.fieldNumber == TokenType && isVarint(tag))
            fields.type = number<std::int32_t>(reader);
        else if (tag.fieldNumber == TokenName && isBytes(tag))
            fields.token = reader.readString();
        else if (tag.fieldNumber == TokenText && isBytes(tag))
            fields.text = reader.readString();
        else if (tag.fieldNumber == TokenValue && tag.wireType == ProtoWireType::Fixed64)
            fields.value = reader.readDouble();
        else
            return false;
        return true;
    });
    return ServerFormatToken::initWithFields(std::move(fields));
}

std::shared_ptr<ServerFormattedString> readFormattedString(ProtoReader& reader) {
    NSArray::Elements formats;
    NSArray::Elements separators;
    NSArray::Elements tokens;
    ServerFormattedString::Fields fields;
    walkSubMessage(reader, [&](ProtoTag tag) {
        if (!isBytes(tag))
            return false;
        if (tag.fieldNumber == Formats)
            formats.push_back(NSString::string(reader.readString()));
        else if (tag.fieldNumber == Separators)
            separators.push_back(NSString::string(reader.readString()));
        else if (tag.fieldNumber == Tokens)
            tokens.push_back(readToken(reader));
        else if (tag.fieldNumber == Alternative)
            fields.alternativeString = reader.readString();
        else
            return false;
        return true;
    });
    fields.formatStrings = NSArray::arrayWithObjects(std::move(formats));
    fields.separators = NSArray::arrayWithObjects(std::move(separators));
    fields.formatTokens = NSArray::arrayWithObjects(std::move(tokens));
    return ServerFormattedString::initWithFields(std::move(fields));
}

std::shared_ptr<TransitTextDataSource> readTextSource(ProtoReader& reader) {
    TransitTextDataSource::Fields fields;
    walkSubMessage(reader, [&](ProtoTag tag) {
        if (tag.fieldNumber != 1 || !isBytes(tag))
            return false;
        fields.text = readFormattedString(reader);
        return true;
    });
    return TransitTextDataSource::initWithFields(std::move(fields));
}

bool readScalar(TransitArtworkDataSource::Fields& fields, ProtoTag tag, ProtoReader& reader) {
    switch (tag.fieldNumber) {
    case SourceType:
        fields.artworkSourceType = number<std::int32_t>(reader);
        return true;
    case UseType:
        fields.artworkUseType = number<std::int32_t>(reader);
        return true;
    case Badge:
        fields.hasRoutingIncidentBadge = reader.readBool();
        return true;
    default:
        return false;
    }
}

bool readRecord(TransitArtworkDataSource::Fields& fields, ProtoTag tag, ProtoReader& reader) {
    switch (tag.fieldNumber) {
    case Shield:
        fields.shieldDataSource = readShield(reader);
        return true;
    case Icon:
        fields.iconDataSource = readIcon(reader);
        return true;
    case FallbackShield:
        fields.iconFallbackShieldDataSource = readShield(reader);
        return true;
    case TextSource:
        fields.textDataSource = readTextSource(reader);
        return true;
    case Accessibility:
        fields.accessibilityText = reader.readString();
        return true;
    default:
        return false;
    }
}

} // namespace

std::shared_ptr<TransitStorageArtwork>
TransitStorageArtwork::initWithArtwork(const std::shared_ptr<TransitArtworkDataSource>& artwork) {
    if (!artwork)
        return nullptr;
    ProtoWriter writer;
    writer.writeInt32(SourceType, artwork->artworkSourceType());
    writer.writeInt32(UseType, artwork->artworkUseType());
    writeRecord(writer, Shield, artwork->shieldDataSource());
    writeRecord(writer, Icon, artwork->iconDataSource());
    writeRecord(writer, FallbackShield, artwork->iconFallbackShieldDataSource());
    writeRecord(writer, TextSource, artwork->textDataSource());
    writer.writeBool(Badge, artwork->hasRoutingIncidentBadge());
    writeText(writer, Accessibility, artwork->accessibilityText());
    auto storage = std::make_shared<TransitStorageArtwork>();
    storage->setBytes(writer.bytes());
    return storage;
}

std::shared_ptr<TransitArtworkDataSource> TransitStorageArtwork::artwork() const {
    TransitArtworkDataSource::Fields fields;
    ProtoReader reader(bytes());
    walk(reader, [&](ProtoTag tag) {
        if (isVarint(tag))
            return readScalar(fields, tag, reader);
        return isBytes(tag) && readRecord(fields, tag, reader);
    });
    return reader.hasError() ? nullptr
                             : TransitArtworkDataSource::initWithFields(std::move(fields));
}

std::shared_ptr<TransitArtworkDataSource>
artworkOf(const std::shared_ptr<TransitStorageArtwork>& storage) {
    return storage ? storage->artwork() : nullptr;
}

} // namespace orvo
