#include "platform/layout/Tableau.h"

#include <algorithm>
#include <cmath>

namespace ktr::platform {

namespace {
// What is left of a sum whose parts cancel to this fraction is rounding, not a factor.
constexpr double kCancelled = 1e-13;
// For so many rows there is room from the start.
constexpr int kUsualRows = 48;
}  // namespace

void Tableau::place(int entity, int where) {
    if (entity >= static_cast<int>(place_.size())) {
        place_.resize(entity + 1, 0);
    }
    place_[entity] = where;
}

void Tableau::addColumn(int entity) {
    const int column = columns();
    if (column == stride_) {
        const int wider = std::max(16, stride_ * 2);
        std::vector<double> cells;
        cells.reserve(static_cast<std::size_t>(std::max(rows(), kUsualRows)) * wider);
        cells.resize(static_cast<std::size_t>(rows()) * wider, 0.0);
        for (int r = 0; r < rows(); ++r) {
            std::copy_n(row(r), column, cells.data() + static_cast<std::ptrdiff_t>(r) * wider);
        }
        cells_ = std::move(cells);
        stride_ = wider;
        used_.reserve(static_cast<std::size_t>(wider));
    }
    columnEntity_.push_back(entity);
    place(entity, -1 - column);
}

int Tableau::addRow(int entity) {
    const int row = rows();
    rowEntity_.push_back(entity);
    cells_.resize(static_cast<std::size_t>(row + 1) * stride_, 0.0);
    place(entity, row);
    return row;
}

void Tableau::addMultiple(int row, int entity, double factor) {
    double* cells = cellsOf(row);
    if (!isRow(entity)) {
        cells[columnOf(entity)] += factor;
        return;
    }
    const double* other = this->row(rowOf(entity));
    for (int j = 0; j < columns(); ++j) {
        const double add = factor * other[j];
        const double sum = cells[j] + add;
        cells[j] = std::abs(sum) <= kCancelled * std::abs(add) ? 0.0 : sum;
    }
}

void Tableau::removeRow(int row) {
    const int last = rows() - 1;
    if (row != last) {
        std::copy_n(cellsOf(last), stride_, cellsOf(row));
        rowEntity_[row] = rowEntity_[last];
        place_[rowEntity_[row]] = row;
    }
    rowEntity_.pop_back();
    cells_.resize(static_cast<std::size_t>(last) * stride_);
}

void Tableau::findMoved(int column, std::vector<int>& moved) const {
    moved.clear();
    const double* cell = cells_.data() + column;
    for (int r = 0; r < rows(); ++r, cell += stride_) {
        if (*cell != 0.0) {
            moved.push_back(r);
        }
    }
}

void Tableau::exchange(int row, int column) {
    std::vector<int> moved;
    findMoved(column, moved);
    exchange(row, column, moved);
}

void Tableau::exchange(int row, int column, std::span<const int> moved) {
    double* pivotRow = cellsOf(row);
    const double inverse = 1.0 / pivotRow[column];
    // The pivot's row solved for the column's entity: only its few non-zero cells touch the other rows.
    used_.clear();
    for (int j = 0; j < columns(); ++j) {
        if (j != column && pivotRow[j] != 0.0) {
            pivotRow[j] *= -inverse;
            used_.push_back(j);
        }
    }
    pivotRow[column] = inverse;
    for (const int r : moved) {
        if (r == row) {
            continue;
        }
        double* cells = cellsOf(r);
        const double factor = cells[column];
        for (const int j : used_) {
            const double add = factor * pivotRow[j];
            const double sum = cells[j] + add;
            cells[j] = std::abs(sum) <= kCancelled * std::abs(add) ? 0.0 : sum;
        }
        cells[column] = factor * inverse;
    }
    std::swap(rowEntity_[row], columnEntity_[column]);
    place_[rowEntity_[row]] = row;
    place_[columnEntity_[column]] = -1 - column;
    ++exchanges_;
}

}  // namespace ktr::platform
