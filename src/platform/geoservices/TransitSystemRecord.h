#pragma once

#include "platform/geoservices/TransitArtworkDataSource.h"
#include "platform/geoservices/TransitSystem.h"

#include <utility>

namespace orvo {

/// A system as a plain immutable value.
class TransitSystemRecord : public virtual TransitSystem {
public:
    struct Fields {
        std::optional<std::string> name;
        std::shared_ptr<TransitArtworkDataSource> artwork;
    };

    [[nodiscard]] static std::shared_ptr<TransitSystemRecord> initWithFields(Fields fields);

    [[nodiscard]] const Fields& fields() const noexcept { return _fields; }

    [[nodiscard]] std::optional<std::string> name() const override { return _fields.name; }
    [[nodiscard]] std::shared_ptr<TransitArtworkDataSource> artwork() const override {
        return _fields.artwork;
    }

protected:
    void _initWithFields(Fields fields) { _fields = std::move(fields); }

private:
    Fields _fields;
};

} // namespace orvo
