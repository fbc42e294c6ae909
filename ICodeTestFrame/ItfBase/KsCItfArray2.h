// A rows x columns array of doubles, indices from 0, stored row-major through the module's
// allocation pair.
#pragma once

#include "ItfBase/KsCItfMemory.h"
#include "ItfHostInterface/KS_Symbols.h"

#include <vector>

class KsCItfArray2 {
public:
    explicit KsCItfArray2(int rows = 1, int columns = 1, double value = 0.0)
        : rows_(rows), columns_(columns),
          values_(static_cast<std::size_t>(rows) * static_cast<std::size_t>(columns), value) {}

    int rows() const { return rows_; }
    int columns() const { return columns_; }
    double& operator()(int row, int column) {
        return values_[static_cast<std::size_t>(row) * columns_ + column];
    }
    double operator()(int row, int column) const {
        return values_[static_cast<std::size_t>(row) * columns_ + column];
    }
    const double* data() const { return values_.data(); }
    // The array as the host reads it during one call.
    KsCConstArray2 view() const { return KsCConstArray2{rows_, columns_, values_.data()}; }

private:
    int rows_;
    int columns_;
    std::vector<double, KsCItfAllocator<double>> values_;
};
