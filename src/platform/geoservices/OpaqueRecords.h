#pragma once

#include "platform/protobuf/ProtoOpaque.h"

namespace orvo {

/// Records of the map application that this program carries and never looks into.

class MapItemStorage final : public ProtoOpaque {
protected:
    [[nodiscard]] std::shared_ptr<ProtoOpaque> _alloc() const override {
        return std::make_shared<MapItemStorage>();
    }
};

class DroppedPin final : public ProtoOpaque {
protected:
    [[nodiscard]] std::shared_ptr<ProtoOpaque> _alloc() const override {
        return std::make_shared<DroppedPin>();
    }
};

class SearchCategoryStorage final : public ProtoOpaque {
protected:
    [[nodiscard]] std::shared_ptr<ProtoOpaque> _alloc() const override {
        return std::make_shared<SearchCategoryStorage>();
    }
};

class RouteRequestStorage final : public ProtoOpaque {
protected:
    [[nodiscard]] std::shared_ptr<ProtoOpaque> _alloc() const override {
        return std::make_shared<RouteRequestStorage>();
    }
};

} // namespace orvo
