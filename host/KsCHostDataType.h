// One host data type: a base type, a typedef of the data dictionary, a structure, or a pointer,
// vector or matrix over another type. The data type server makes each type once.
#pragma once

#include "ItfHostInterface/KS_DataTypeServer.h"

#include <memory>
#include <string>
#include <unordered_map>
#include <vector>

class KS_HOST_API KsCHostDataType : public KS_DataType {
public:
    enum class Kind { Void, Integer, Float, Bool, Undefined, Pointer, Vector, Matrix, Struct };
    struct Component {
        std::string name;
        KsCHostDataType* type;
    };

    KsCHostDataType(Kind kind, std::string name, int bits = 0, bool isSigned = false);
    ~KsCHostDataType() override;

    ZnCXString getName() const override { return ZnCXString(name_); }
    bool isPointer() const override { return kind_ == Kind::Pointer; }
    bool isFloat() const override;
    bool isSignedInteger() const override;
    bool isUnsignedInteger() const override;
    int getBitWidth() const override;
    KS_DataType* getNumericalType() override { return isNumerical() ? this : nullptr; }
    double getLowerLimit() const override { return isNumerical() ? minValue() : 0.0; }
    double getUpperLimit() const override { return isNumerical() ? maxValue() : 0.0; }

    const std::string& name() const { return name_; }
    Kind kind() const { return kind_; }
    int getDimensionCount() const override { return isVector() ? 1 : isMatrix() ? 2 : 0; }
    bool isVector() const { return kind_ == Kind::Vector; }
    bool isMatrix() const { return kind_ == Kind::Matrix; }
    bool isStruct() const { return kind_ == Kind::Struct; }
    // Integer, floating, boolean and the undefined numerical type, typedefs of them included.
    bool isNumerical() const {
        return kind_ == Kind::Integer || kind_ == Kind::Float || kind_ == Kind::Bool ||
               kind_ == Kind::Undefined;
    }
    // The pointer's target, the vector's or matrix's element; null for other types.
    KsCHostDataType* element() const { return element_; }
    // A vector is 1 x width, a matrix rows x columns, anything else 1 x 1.
    int rows() const { return rows_; }
    int columns() const { return columns_; }
    int elementCount() const { return rows_ * columns_; }
    const std::vector<Component>& components() const { return components_; }
    // The dictionary path of a typedef; empty for other types.
    const std::string& ddPath() const { return ddPath_; }
    // The smallest and largest value of one element; numerical types and pointers only. The
    // undefined numerical type spans the widest signed integer's values.
    bool hasLimits() const;
    double minValue() const;
    double maxValue() const;

private:
    friend class KsCHostDataTypeServer;

    Kind kind_;
    std::string name_;
    int bits_;
    bool signed_;
    KsCHostDataType* element_ = nullptr;
    int rows_ = 1;
    int columns_ = 1;
    std::vector<Component> components_;
    std::string ddPath_;
    // The types made over this one, so that each is made once.
    KsCHostDataType* pointer_ = nullptr;
    std::unordered_map<long long, KsCHostDataType*> arrays_;
};
