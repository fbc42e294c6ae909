#include "KsCHostDataType.h"

#include <cfloat>
#include <cmath>

KS_DataType::~KS_DataType() = default;

KsCHostDataType::KsCHostDataType(Kind kind, std::string name, int bits, bool isSigned)
    : kind_(kind), name_(std::move(name)), bits_(bits), signed_(isSigned) {}

KsCHostDataType::~KsCHostDataType() = default;

bool KsCHostDataType::isFloat() const {
    if (kind_ == Kind::Vector || kind_ == Kind::Matrix)
        return element_->isFloat();
    return kind_ == Kind::Float;
}

bool KsCHostDataType::isSignedInteger() const {
    if (kind_ == Kind::Vector || kind_ == Kind::Matrix)
        return element_->isSignedInteger();
    return kind_ == Kind::Integer && signed_;
}

bool KsCHostDataType::isUnsignedInteger() const {
    if (kind_ == Kind::Vector || kind_ == Kind::Matrix)
        return element_->isUnsignedInteger();
    return (kind_ == Kind::Integer && !signed_) || kind_ == Kind::Bool;
}

int KsCHostDataType::getBitWidth() const {
    if (kind_ == Kind::Vector || kind_ == Kind::Matrix)
        return element_->getBitWidth();
    return bits_;
}

bool KsCHostDataType::hasLimits() const {
    switch (kind_) {
    case Kind::Integer:
    case Kind::Float:
    case Kind::Bool:
    case Kind::Undefined:
    case Kind::Pointer:
        return true;
    case Kind::Vector:
    case Kind::Matrix:
        return element_->hasLimits();
    default:
        return false;
    }
}

double KsCHostDataType::minValue() const {
    switch (kind_) {
    case Kind::Integer:
        return signed_ ? -std::ldexp(1.0, bits_ - 1) : 0.0;
    case Kind::Float:
        return bits_ == 32 ? -static_cast<double>(FLT_MAX) : -DBL_MAX;
    case Kind::Undefined:
        return -std::ldexp(1.0, 63);
    case Kind::Vector:
    case Kind::Matrix:
        return element_->minValue();
    default:
        return 0.0;
    }
}

double KsCHostDataType::maxValue() const {
    switch (kind_) {
    case Kind::Integer:
        return signed_ ? std::ldexp(1.0, bits_ - 1) - 1.0 : std::ldexp(1.0, bits_) - 1.0;
    case Kind::Float:
        return bits_ == 32 ? static_cast<double>(FLT_MAX) : DBL_MAX;
    case Kind::Bool:
        return 1.0;
    case Kind::Undefined:
        return std::ldexp(1.0, 63) - 1.0;
    case Kind::Pointer:
        return std::ldexp(1.0, bits_) - 1.0;
    case Kind::Vector:
    case Kind::Matrix:
        return element_->maxValue();
    default:
        return 0.0;
    }
}
