#pragma once

#include "platform/foundation/NSMapTable.h"
#include "platform/geoservices/TransitIncident.h"
#include "platform/geoservices/TransitLineItem.h"
#include "viewmodel/OWTransitItem.h"

#include <memory>
#include <unordered_map>
#include <vector>

namespace orvo {

/// A row and the lines that show it, in the order in which they were met; a line that has the
/// incident twice stands there twice.
struct _OWDisplayedRow {
    std::shared_ptr<OWTransitItem> item;
    std::vector<std::shared_ptr<TransitLineItem>> lines;
};

/// What one build of the list collects: the displayed incidents, row i being that of incident i,
/// and the lines that got no row of their own.
class _OWDisplayedIncidents {
public:
    /// Nil for an incident that has none yet.
    [[nodiscard]] _OWDisplayedRow* rowOfIncident(std::uint64_t muid);
    /// The first meeting with an incident, in `line`.
    void add(const std::shared_ptr<TransitIncident>& incident,
             std::shared_ptr<OWTransitItem> row,
             const std::shared_ptr<TransitLineItem>& line);
    void addClearLine(std::shared_ptr<TransitLineItem> line) {
        _clearLines.push_back(std::move(line));
    }

    [[nodiscard]] const std::vector<std::shared_ptr<TransitIncident>>& incidents() const noexcept {
        return _incidents;
    }
    [[nodiscard]] std::vector<_OWDisplayedRow>& rows() noexcept { return _rows; }
    [[nodiscard]] const std::vector<std::shared_ptr<TransitLineItem>>& clearLines() const noexcept {
        return _clearLines;
    }
    /// Each incident, by identity, to the line in which it was first met.
    [[nodiscard]] const std::shared_ptr<NSMapTable>& incidentsToLineMapping() const noexcept {
        return _incidentsToLineMapping;
    }

private:
    std::vector<std::shared_ptr<TransitIncident>> _incidents;
    std::vector<_OWDisplayedRow> _rows;
    std::unordered_map<std::uint64_t, std::size_t> _positionOfMuid; // the first of each
    std::vector<std::shared_ptr<TransitLineItem>> _clearLines;
    std::shared_ptr<NSMapTable> _incidentsToLineMapping = NSMapTable::identityMapTable();
};

} // namespace orvo
