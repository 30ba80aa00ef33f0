#pragma once

#include "handoff/DirectionsPlan.h"
#include "platform/favorites/TransitStorageLineItem.h"
#include "platform/geoservices/OpaqueRecords.h"
#include "platform/geoservices/URLOptions.h"
#include "platform/protobuf/ProtoMessage.h"

#include <array>
#include <optional>
#include <string>
#include <vector>

namespace orvo {

enum class CollectionsMode : std::int32_t { None = 0, Bookmarks = 1, Recents = 2, Contacts = 3 };

/// Tells the map application what to show. This program fills `lineItem` and `displayOptions`; the
/// rest is the application's whole schema.
class OrvoActivity final : public ProtoMessage<OrvoActivity> {
public:
    // Presence bits: by width, then by name; the application numbers them so.
    static constexpr std::uint32_t SelectedPlaceIndexBit = 1;
    static constexpr std::uint32_t SelectedTransitFeatureIDBit = 2;
    static constexpr std::uint32_t CollectionsModeBit = 4;
    static constexpr std::uint32_t IsDroppedPinPresentedBit = 8;
    static constexpr std::uint32_t IsDroppedPinSelectedBit = 16;
    static constexpr std::uint32_t IsPresentingSelectedPlaceBit = 32;

    static constexpr std::array CollectionsModeNames{"None", "Bookmarks", "Recents", "Contacts"};

    [[nodiscard]] const std::shared_ptr<URLOptions>& displayOptions() const noexcept {
        return _displayOptions;
    }
    void setDisplayOptions(std::shared_ptr<URLOptions> value) {
        _displayOptions = std::move(value);
    }
    [[nodiscard]] bool hasDisplayOptions() const noexcept { return _displayOptions != nullptr; }
    [[nodiscard]] std::int32_t collectionsMode() const noexcept { return _collectionsMode; }
    void setCollectionsMode(std::int32_t value) noexcept {
        assign(_collectionsMode, value, CollectionsModeBit);
    }
    [[nodiscard]] bool hasCollectionsMode() const noexcept { return hasBit(CollectionsModeBit); }
    void setHasCollectionsMode(bool present) noexcept { setHasBit(CollectionsModeBit, present); }
    [[nodiscard]] static std::string collectionsModeAsString(std::int32_t value);
    [[nodiscard]] static std::int32_t StringAsCollectionsMode(const std::string& name);
    [[nodiscard]] const std::optional<std::string>& searchString() const noexcept {
        return _searchString;
    }
    void setSearchString(std::optional<std::string> value) { _searchString = std::move(value); }
    [[nodiscard]] bool hasSearchString() const noexcept { return _searchString.has_value(); }
    [[nodiscard]] const std::vector<std::shared_ptr<MapItemStorage>>&
    searchPlaces() const noexcept {
        return _searchPlaces;
    }
    void setSearchPlaces(std::vector<std::shared_ptr<MapItemStorage>> value) {
        _searchPlaces = std::move(value);
    }
    void clearSearchPlaces() { _searchPlaces.clear(); }
    /// @throws NSInvalidArgumentException for nil
    void addSearchPlaces(std::shared_ptr<MapItemStorage> element);
    [[nodiscard]] std::size_t searchPlacesCount() const noexcept { return _searchPlaces.size(); }
    /// @throws NSInvalidArgumentException past the end
    [[nodiscard]] std::shared_ptr<MapItemStorage> searchPlacesAtIndex(std::size_t index) const;
    /// The name of the elements' class.
    [[nodiscard]] static std::string searchPlacesType() { return "MapItemStorage"; }
    [[nodiscard]] std::uint64_t selectedPlaceIndex() const noexcept { return _selectedPlaceIndex; }
    void setSelectedPlaceIndex(std::uint64_t value) noexcept {
        assign(_selectedPlaceIndex, value, SelectedPlaceIndexBit);
    }
    [[nodiscard]] bool hasSelectedPlaceIndex() const noexcept {
        return hasBit(SelectedPlaceIndexBit);
    }
    void setHasSelectedPlaceIndex(bool present) noexcept {
        setHasBit(SelectedPlaceIndexBit, present);
    }
    [[nodiscard]] bool isPresentingSelectedPlace() const noexcept {
        return _isPresentingSelectedPlace;
    }
    void setIsPresentingSelectedPlace(bool value) noexcept {
        assign(_isPresentingSelectedPlace, value, IsPresentingSelectedPlaceBit);
    }
    [[nodiscard]] bool hasIsPresentingSelectedPlace() const noexcept {
        return hasBit(IsPresentingSelectedPlaceBit);
    }
    void setHasIsPresentingSelectedPlace(bool present) noexcept {
        setHasBit(IsPresentingSelectedPlaceBit, present);
    }
    [[nodiscard]] const std::shared_ptr<DirectionsPlan>& directionsPlan() const noexcept {
        return _directionsPlan;
    }
    void setDirectionsPlan(std::shared_ptr<DirectionsPlan> value) {
        _directionsPlan = std::move(value);
    }
    [[nodiscard]] bool hasDirectionsPlan() const noexcept { return _directionsPlan != nullptr; }
    [[nodiscard]] const std::shared_ptr<DroppedPin>& droppedPin() const noexcept {
        return _droppedPin;
    }
    void setDroppedPin(std::shared_ptr<DroppedPin> value) { _droppedPin = std::move(value); }
    [[nodiscard]] bool hasDroppedPin() const noexcept { return _droppedPin != nullptr; }
    [[nodiscard]] bool isDroppedPinSelected() const noexcept { return _isDroppedPinSelected; }
    void setIsDroppedPinSelected(bool value) noexcept {
        assign(_isDroppedPinSelected, value, IsDroppedPinSelectedBit);
    }
    [[nodiscard]] bool hasIsDroppedPinSelected() const noexcept {
        return hasBit(IsDroppedPinSelectedBit);
    }
    void setHasIsDroppedPinSelected(bool present) noexcept {
        setHasBit(IsDroppedPinSelectedBit, present);
    }
    [[nodiscard]] bool isDroppedPinPresented() const noexcept { return _isDroppedPinPresented; }
    void setIsDroppedPinPresented(bool value) noexcept {
        assign(_isDroppedPinPresented, value, IsDroppedPinPresentedBit);
    }
    [[nodiscard]] bool hasIsDroppedPinPresented() const noexcept {
        return hasBit(IsDroppedPinPresentedBit);
    }
    void setHasIsDroppedPinPresented(bool present) noexcept {
        setHasBit(IsDroppedPinPresentedBit, present);
    }
    [[nodiscard]] const std::shared_ptr<MapItemStorage>& presentedMapItem() const noexcept {
        return _presentedMapItem;
    }
    void setPresentedMapItem(std::shared_ptr<MapItemStorage> value) {
        _presentedMapItem = std::move(value);
    }
    [[nodiscard]] bool hasPresentedMapItem() const noexcept { return _presentedMapItem != nullptr; }
    [[nodiscard]] const std::shared_ptr<SearchCategoryStorage>&
    searchCategoryStorage() const noexcept {
        return _searchCategoryStorage;
    }
    void setSearchCategoryStorage(std::shared_ptr<SearchCategoryStorage> value) {
        _searchCategoryStorage = std::move(value);
    }
    [[nodiscard]] bool hasSearchCategoryStorage() const noexcept {
        return _searchCategoryStorage != nullptr;
    }
    [[nodiscard]] std::uint64_t selectedTransitFeatureID() const noexcept {
        return _selectedTransitFeatureID;
    }
    void setSelectedTransitFeatureID(std::uint64_t value) noexcept {
        assign(_selectedTransitFeatureID, value, SelectedTransitFeatureIDBit);
    }
    [[nodiscard]] bool hasSelectedTransitFeatureID() const noexcept {
        return hasBit(SelectedTransitFeatureIDBit);
    }
    void setHasSelectedTransitFeatureID(bool present) noexcept {
        setHasBit(SelectedTransitFeatureIDBit, present);
    }
    [[nodiscard]] const std::optional<std::string>& selectedTransitLineName() const noexcept {
        return _selectedTransitLineName;
    }
    void setSelectedTransitLineName(std::optional<std::string> value) {
        _selectedTransitLineName = std::move(value);
    }
    [[nodiscard]] bool hasSelectedTransitLineName() const noexcept {
        return _selectedTransitLineName.has_value();
    }
    [[nodiscard]] const std::shared_ptr<TransitStorageLineItem>& lineItem() const noexcept {
        return _lineItem;
    }
    void setLineItem(std::shared_ptr<TransitStorageLineItem> value) {
        _lineItem = std::move(value);
    }
    [[nodiscard]] bool hasLineItem() const noexcept { return _lineItem != nullptr; }

    [[nodiscard]] static auto schema() {
        return std::tuple{
            ProtoMessageField<OrvoActivity, URLOptions>{
                1, "displayOptions", &OrvoActivity::_displayOptions},
            ProtoScalarField<OrvoActivity, std::int32_t>{2,
                                                         "collectionsMode",
                                                         &OrvoActivity::_collectionsMode,
                                                         CollectionsModeBit,
                                                         CollectionsModeNames},
            ProtoStringField<OrvoActivity>{3, "searchString", &OrvoActivity::_searchString},
            ProtoRepeatedField<OrvoActivity, MapItemStorage>{
                4, "searchPlaces", &OrvoActivity::_searchPlaces},
            ProtoScalarField<OrvoActivity, std::uint64_t>{
                5, "selectedPlaceIndex", &OrvoActivity::_selectedPlaceIndex, SelectedPlaceIndexBit},
            ProtoScalarField<OrvoActivity, bool>{6,
                                                 "isPresentingSelectedPlace",
                                                 &OrvoActivity::_isPresentingSelectedPlace,
                                                 IsPresentingSelectedPlaceBit},
            ProtoMessageField<OrvoActivity, DirectionsPlan>{
                7, "directionsPlan", &OrvoActivity::_directionsPlan},
            ProtoMessageField<OrvoActivity, DroppedPin>{
                8, "droppedPin", &OrvoActivity::_droppedPin},
            ProtoScalarField<OrvoActivity, bool>{9,
                                                 "isDroppedPinSelected",
                                                 &OrvoActivity::_isDroppedPinSelected,
                                                 IsDroppedPinSelectedBit},
            ProtoScalarField<OrvoActivity, bool>{10,
                                                 "isDroppedPinPresented",
                                                 &OrvoActivity::_isDroppedPinPresented,
                                                 IsDroppedPinPresentedBit},
            ProtoMessageField<OrvoActivity, MapItemStorage>{
                11, "presentedMapItem", &OrvoActivity::_presentedMapItem},
            ProtoMessageField<OrvoActivity, SearchCategoryStorage>{
                12, "searchCategoryStorage", &OrvoActivity::_searchCategoryStorage},
            ProtoScalarField<OrvoActivity, std::uint64_t>{13,
                                                          "selectedTransitFeatureID",
                                                          &OrvoActivity::_selectedTransitFeatureID,
                                                          SelectedTransitFeatureIDBit},
            ProtoStringField<OrvoActivity>{
                14, "selectedTransitLineName", &OrvoActivity::_selectedTransitLineName},
            ProtoMessageField<OrvoActivity, TransitStorageLineItem>{
                15, "lineItem", &OrvoActivity::_lineItem}};
    }

private:
    friend class ProtoMessage<OrvoActivity>;

    std::shared_ptr<URLOptions> _displayOptions;
    std::int32_t _collectionsMode = 0;
    std::optional<std::string> _searchString;
    std::vector<std::shared_ptr<MapItemStorage>> _searchPlaces;
    std::uint64_t _selectedPlaceIndex = 0;
    bool _isPresentingSelectedPlace = false;
    std::shared_ptr<DirectionsPlan> _directionsPlan;
    std::shared_ptr<DroppedPin> _droppedPin;
    bool _isDroppedPinSelected = false;
    bool _isDroppedPinPresented = false;
    std::shared_ptr<MapItemStorage> _presentedMapItem;
    std::shared_ptr<SearchCategoryStorage> _searchCategoryStorage;
    std::uint64_t _selectedTransitFeatureID = 0;
    std::optional<std::string> _selectedTransitLineName;
    std::shared_ptr<TransitStorageLineItem> _lineItem;
};

} // namespace orvo
