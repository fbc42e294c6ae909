// One host scaling: a named scaling, or LSB/OFFSET for a scalar, for every element of a vector
// or matrix, or per element.
#pragma once

#include "ItfHostInterface/KS_ScaleServer.h"

#include <string>
#include <vector>

class KS_HOST_API KsCHostScaling : public KS_Scaling {
public:
    enum class Kind { Named, Scalar, Vector, Matrix };

    // A named scaling.
    explicit KsCHostScaling(std::string name);
    // LSB/OFFSET: one pair for all rows x columns elements, or one per element (row-major).
    KsCHostScaling(Kind kind, int rows, int columns, std::vector<double> lsbs,
                   std::vector<double> offsets);
    ~KsCHostScaling() override;

    ZnCXString getName() const override { return ZnCXString(name_); }

    Kind kind() const { return kind_; }
    const std::string& name() const { return name_; }
    bool isNamed() const { return kind_ == Kind::Named; }
    // A vector is 1 x width; a scalar 1 x 1.
    int rows() const { return rows_; }
    int columns() const { return columns_; }
    // One value for a uniform scaling, rows x columns values for a per-element one.
    const std::vector<double>& lsbs() const { return lsbs_; }
    const std::vector<double>& offsets() const { return offsets_; }
    bool isPerElement() const { return lsbs_.size() > 1; }

private:
    Kind kind_;
    std::string name_;
    int rows_ = 1;
    int columns_ = 1;
    std::vector<double> lsbs_;
    std::vector<double> offsets_;
};
