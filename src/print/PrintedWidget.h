#pragma once

#include "print/PrintedRow.h"
#include "viewmodel/OWTransitListItem.h"
#include "widget/result/Result.h"

#include <memory>
#include <vector>

namespace orvo {

/// How the favourite lines run, in one word.
enum class ServiceState {
    NoFavorites,
    Good,
    Advisories,
    Unavailable, ///< they could not be loaded
};

/// Everything that the widget shows, as plain values.
struct PrintedWidget {
    PrintedRow summary;               ///< the compact mode's row
    std::vector<PrintedRow> expanded; ///< the expanded mode's rows
    ServiceState state = ServiceState::Unavailable;
    /// How many of a hundred favourite lines have no current incident, rounded down; 0 where
    /// nothing is known or there are none.
    int clearPercentage = 0;

    /// Of the widget's rows. `result`: the line items that they were made of, or why there are
    /// none.
    [[nodiscard]] static PrintedWidget of(const OWTransitListItem& list,
                                          const std::shared_ptr<Result>& result);
};

} // namespace orvo
