#include "platform/uikit/solver/SparseTableau.h"

#include <algorithm>
#include <cmath>

namespace orvo {

void SparseTableau::reserve(std::size_t count) {
    if (count <= _heads.size())
        return;
    _heads.resize(count);
    _marks.resize(count);
    _sum.resize(count, 0);
}

void SparseTableau::clear() noexcept {
    _entries.clear();
    _firstFree = None;
    std::fill(_heads.begin(), _heads.end(), Head{});
}

void SparseTableau::addColumnToSum(Symbol column, double factor) {
    if (Mark& mark = _marks[column]; mark.stamp != _stamp || _sumColumns.empty()) {
        if (_sumColumns.empty())
            nextStamp();
        mark.stamp = _stamp;
        _sum[column] = 0;
        _sumColumns.push_back(column);
    }
    _sum[column] += factor;
}

void SparseTableau::addRowToSum(Symbol row, double factor) {
    for (Place place = _heads[row].row; place != None; place = _entries[place].nextInRow)
        addColumnToSum(_entries[place].column, factor * _entries[place].coefficient);
}

void SparseTableau::makeRowOfSum(Symbol row) {
    for (const Symbol column : _sumColumns) {
        if (std::abs(_sum[column]) > Negligible)
            newEntry(row, column, _sum[column]);
    }
    _sumColumns.clear();
}

void SparseTableau::eraseRow(Symbol row) noexcept {
    for (Place place = _heads[row].row; place != None;) {
        const Place next = _entries[place].nextInRow;
        unlinkFromColumn(_entries[place]);
        _entries[place].nextInRow = _firstFree;
        _firstFree = place;
        place = next;
    }
    _heads[row].row = None;
}

void SparseTableau::pivot(Place place) {
    const Symbol leaving = _entries[place].row;
    const Symbol entering = _entries[place].column;
    const double inverse = 1 / _entries[place].coefficient;

    unlinkFromColumn(_entries[place]);
    for (Place at = _heads[leaving].row; at != None; at = _entries[at].nextInRow) {
        _entries[at].row = entering;
        _entries[at].coefficient *= -inverse;
    }
    _heads[entering].row = _heads[leaving].row;
    _heads[leaving].row = None;
    _entries[place].column = leaving;
    _entries[place].coefficient = inverse;
    linkIntoColumn(place);

    for (Place at = _heads[entering].column; at != None;) {
        const Entry replaced = _entries[at];
        erase(at);
        addRow(replaced.row, replaced.coefficient, entering);
        at = replaced.nextInColumn;
    }
}

void SparseTableau::newEntry(Symbol row, Symbol column, double coefficient) {
    Place place = _firstFree;
    if (place == None) {
        place = static_cast<Place>(_entries.size());
        _entries.emplace_back();
    } else {
        _firstFree = _entries[place].nextInRow;
    }
    Head& head = _heads[row];
    Entry& entry = _entries[place];
    entry.coefficient = coefficient;
    entry.row = row;
    entry.column = column;
    entry.previousInRow = None;
    entry.nextInRow = head.row;
    if (head.row != None)
        _entries[head.row].previousInRow = place;
    head.row = place;
    linkIntoColumn(place);
}

void SparseTableau::linkIntoColumn(Place place) noexcept {
    Entry& entry = _entries[place];
    Head& head = _heads[entry.column];
    entry.previousInColumn = None;
    entry.nextInColumn = head.column;
    if (head.column != None)
        _entries[head.column].previousInColumn = place;
    head.column = place;
}

void SparseTableau::unlinkFromRow(const Entry& entry) noexcept {
    if (entry.previousInRow == None)
        _heads[entry.row].row = entry.nextInRow;
    else
        _entries[entry.previousInRow].nextInRow = entry.nextInRow;
    if (entry.nextInRow != None)
        _entries[entry.nextInRow].previousInRow = entry.previousInRow;
}

void SparseTableau::unlinkFromColumn(const Entry& entry) noexcept {
    if (entry.previousInColumn == None)
        _heads[entry.column].column = entry.nextInColumn;
    else
        _entries[entry.previousInColumn].nextInColumn = entry.nextInColumn;
    if (entry.nextInColumn != None)
        _entries[entry.nextInColumn].previousInColumn = entry.previousInColumn;
}

void SparseTableau::erase(Place place) noexcept {
    unlinkFromRow(_entries[place]);
    unlinkFromColumn(_entries[place]);
    _entries[place].nextInRow = _firstFree;
    _firstFree = place;
}

void SparseTableau::addRow(Symbol target, double factor, Symbol source) {
    const std::uint32_t stamp = nextStamp();
    for (Place at = _heads[target].row; at != None; at = _entries[at].nextInRow)
        _marks[_entries[at].column] = {stamp, at};
    for (Place at = _heads[source].row; at != None; at = _entries[at].nextInRow) {
        const Symbol column = _entries[at].column;
        const double change = factor * _entries[at].coefficient;
        if (_marks[column].stamp != stamp) {
            if (std::abs(change) > Negligible)
                newEntry(target, column, change);
            continue;
        }
        double& coefficient = _entries[_marks[column].place].coefficient;
        coefficient += change;
        if (std::abs(coefficient) <= Negligible)
            erase(_marks[column].place);
    }
}

std::uint32_t SparseTableau::nextStamp() noexcept {
    if (++_stamp == 0) {
        std::fill(_marks.begin(), _marks.end(), Mark{});
        _stamp = 1;
    }
    return _stamp;
}

} // namespace orvo
