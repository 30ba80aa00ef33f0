#include "viewmodel/OWConfiguredArtwork.h"

#include "platform/foundation/Hashing.h"
#include "platform/foundation/NSCoding.h"
#include "platform/foundation/NSKeyedArchiver.h"

namespace orvo {

namespace {

bool conformsToSecureCoding(const ArtworkImageSource& source) {
    return dynamic_cast<const NSSecureCoding*>(&source) && supportsSecureCoding(&source);
}

std::shared_ptr<NSData> archiveOf(const std::shared_ptr<ArtworkImageSource>& source) {
    return NSKeyedArchiver::archivedDataWithRootObject_requiringSecureCoding_error(
        source, true, nullptr);
}

bool sameSource(const std::shared_ptr<ArtworkImageSource>& a,
                const std::shared_ptr<ArtworkImageSource>& b) {
    if (!a || !b)
        return !a && !b;
    if (a->isEqual(b.get()))
        return true;
    if (!conformsToSecureCoding(*a) || !conformsToSecureCoding(*b))
        return false;
    const auto archive = archiveOf(a);
    return archive && archive->isEqual(archiveOf(b).get());
}

} // namespace

std::shared_ptr<OWConfiguredArtwork>
OWConfiguredArtwork::initWithArtworkSource_alpha(std::shared_ptr<ArtworkImageSource> artworkSource,
                                                 double alpha) {
    auto artwork = std::make_shared<OWConfiguredArtwork>();
    artwork->_artworkSource = std::move(artworkSource);
    artwork->_alpha = alpha;
    return artwork;
}

bool OWConfiguredArtwork::isEqual(const NSObject* other) const {
    const auto* artwork = dynamic_cast<const OWConfiguredArtwork*>(other);
    return artwork && isEqualToConfiguredArtwork(*artwork);
}

bool OWConfiguredArtwork::isEqualToConfiguredArtwork(const OWConfiguredArtwork& other) const {
    return _alpha == other._alpha && sameSource(_artworkSource, other._artworkSource);
}

std::uint64_t OWConfiguredArtwork::hash() const {
    return hashOfDouble(_alpha) ^ hashOf(_artworkSource);
}

} // namespace orvo
