#pragma once

#include <cstddef>
#include <cstdint>
#include <limits>
#include <vector>

namespace orvo {

/// Says each symbol of one kind, the rows, as a sum of symbols of the other kind, the columns. A
/// symbol is a row or a column, never both; a pivot lets two of them change places.
///
/// Only what is not zero is stored, each entry in the list of its row and in that of its column,
/// all in one block of memory. What falls below `Negligible` is rounding and is dropped.
class SparseTableau {
public:
    using Symbol = std::uint32_t;
    using Place = std::uint32_t; ///< of an entry; changes hands when the entry is dropped

    static constexpr Place None = std::numeric_limits<Place>::max();
    static constexpr double Negligible = 1e-11;

    struct Entry {
        double coefficient = 0;
        Symbol row = 0;
        Symbol column = 0;
        Place nextInRow = None;
        Place previousInRow = None;
        Place nextInColumn = None;
        Place previousInColumn = None;
    };

    /// Makes room for symbols below `count`; never shrinks.
    void reserve(std::size_t count);
    /// Drops all entries.
    void clear() noexcept;

    [[nodiscard]] Place firstInRow(Symbol row) const noexcept { return _heads[row].row; }
    [[nodiscard]] Place firstInColumn(Symbol column) const noexcept {
        return _heads[column].column;
    }
    [[nodiscard]] const Entry& operator[](Place place) const noexcept { return _entries[place]; }

    /// A row is made in three steps: add columns, add multiples of rows, make it.
    void addColumnToSum(Symbol column, double factor);
    void addRowToSum(Symbol row, double factor);
    /// Makes the sum the row of a symbol that has none, and begins the next sum.
    void makeRowOfSum(Symbol row);
    /// Drops a row with its entries.
    void eraseRow(Symbol row) noexcept;

    /// The row of the entry becomes a column, and its column a row.
    /// The entry must not be small: everything is divided by it.
    void pivot(Place place);

private:
    struct Head {
        Place row = None;
        Place column = None;
    };
    /// Where the row being worked on has its entry of a column, if the stamp is the current one.
    struct Mark {
        std::uint32_t stamp = 0;
        Place place = None;
    };

    void newEntry(Symbol row, Symbol column, double coefficient);
    void linkIntoColumn(Place place) noexcept;
    void unlinkFromRow(const Entry& entry) noexcept;
    void unlinkFromColumn(const Entry& entry) noexcept;
    void erase(Place place) noexcept;
    void addRow(Symbol target, double factor, Symbol source);
    std::uint32_t nextStamp() noexcept;

    std::vector<Entry> _entries;
    std::vector<Head> _heads;
    std::vector<Mark> _marks;
    std::vector<double> _sum;
    std::vector<Symbol> _sumColumns;
    Place _firstFree = None; // linked by nextInRow
    std::uint32_t _stamp = 0;
};

} // namespace orvo
