#pragma once

#include <cstddef>
#include <span>
#include <vector>

namespace ktr::platform {

/// The solver's dense tableau. Every variable and every constraint is an *entity* with a value; a constraint's value is
/// its left side minus its constant. As many entities as there are variables are *columns*: they may be moved at will.
/// All others are *rows*: moving column j by d moves row r by at(r, j) * d. The tableau holds these factors only, no
/// values, so that solvers of one structure can share it. Entities are numbered by the owner.
class Tableau {
  public:
    int rows() const { return static_cast<int>(rowEntity_.size()); }
    int columns() const { return static_cast<int>(columnEntity_.size()); }
    double at(int row, int column) const { return this->row(row)[column]; }
    const double* row(int row) const { return cells_.data() + offset(row); }
    int rowEntity(int row) const { return rowEntity_[index(row)]; }
    int columnEntity(int column) const { return columnEntity_[index(column)]; }
    bool isRow(int entity) const { return place_[index(entity)] >= 0; }
    int rowOf(int entity) const { return place_[index(entity)]; }
    int columnOf(int entity) const { return -1 - place_[index(entity)]; }

    /// A new independent entity.
    void addColumn(int entity);
    /// A new dependent entity whose row is all zero: fill it with addMultiple.
    int addRow(int entity);
    /// row += factor * the row (or the unit column) of `entity`.
    void addMultiple(int row, int entity, double factor);
    /// Forgets a dependent entity.
    void removeRow(int row);
    /// Swaps roles: the row's entity becomes independent, the column's dependent. at(row, column) must not be zero.
    void exchange(int row, int column);
    /// The same by somebody who knows the rows that the column moves.
    void exchange(int row, int column, std::span<const int> moved);
    /// The rows that the column moves: those whose cell is not zero.
    void findMoved(int column, std::vector<int>& moved) const;

    /// Exchanges that rounding has grown with.
    int exchanges() const { return exchanges_; }
    void forgetExchanges() { exchanges_ = 0; }

  private:
    static std::size_t index(int number) { return static_cast<std::size_t>(number); }
    std::ptrdiff_t offset(int row) const { return static_cast<std::ptrdiff_t>(row) * stride_; }
    double* cellsOf(int row) { return cells_.data() + offset(row); }
    void place(int entity, int where);

    int stride_ = 0;
    int exchanges_ = 0;
    std::vector<double> cells_;
    std::vector<int> rowEntity_;
    std::vector<int> columnEntity_;
    std::vector<int> place_;  // by entity: its row, or -1 - its column
    std::vector<int> used_;   // scratch of exchange
};

}  // namespace ktr::platform
