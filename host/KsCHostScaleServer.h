// The stand-in scale server: LSB/OFFSET scalings, made once per distinct value, the named
// default scalings, and the scalings the configuration stores under data dictionary keys.
#pragma once

#include "ItfHostInterface/KS_ScaleServer.h"
#include "KsCHostScaling.h"

#include <memory>
#include <string>
#include <unordered_map>
#include <vector>

class KsCHostConfig;

class KS_HOST_API KsCHostScaleServer : public KS_ScaleServer {
public:
    explicit KsCHostScaleServer(const KsCHostConfig& config);
    ~KsCHostScaleServer() override;

    // The named scalings in the order of the interface, then the others in creation order.
    const std::vector<std::unique_ptr<KsCHostScaling>>& scalings() const { return scalings_; }
    // The named scalings the listing compares operations with.
    const KsCHostScaling* defaultScaling() const { return named_[0]; }
    const KsCHostScaling* defaultBoolScaling() const { return named_[5]; }
    // Null for a width or a number of rows or columns below 1.
    KsCHostScaling* demand(KsCHostScaling::Kind kind, int rows, int columns, const double* lsbs,
                           const double* offsets, bool perElement);

    KS_Scaling* getScaling(double lsb, double offset, KsCSrcRef* srcRef) override;
    KS_Scaling* getVector(int width, double lsb, double offset, KsCSrcRef* srcRef) override;
    KS_Scaling* getMatrix(int rows, int columns, double lsb, double offset,
                          KsCSrcRef* srcRef) override;
    KS_Scaling* getScaling(int width, const double* lsbs, const double* offsets,
                           KsCSrcRef* srcRef) override;
    KS_Scaling* getScaling(int rows, int columns, const double* lsbs, const double* offsets,
                           KsCSrcRef* srcRef) override;

    KS_Scaling* getDefaultScaling() override { return named_[0]; }
    KS_Scaling* getUndefinedScaling() override { return named_[1]; }
    KS_Scaling* getAdaptiveScaling() override { return named_[2]; }
    KS_Scaling* getDefaultBitfieldScaling() override { return named_[3]; }
    KS_Scaling* getDefaultFloatScaling() override { return named_[4]; }
    KS_Scaling* getDefaultBoolScaling() override { return named_[5]; }
    KS_Scaling* getDefaultMathFuncScaling() override { return named_[6]; }
    KS_Scaling* getDefaultPointerScaling() override { return named_[7]; }
    KS_Scaling* getDefaultStateflowScaling() override { return named_[8]; }
    KS_Scaling* getDefaultVoidScaling() override { return named_[9]; }
    KS_Scaling* getDefaultEnumComponentScaling() override { return named_[10]; }
    KS_Scaling* getDefaultEnumScaling() override { return named_[11]; }
    // The configured scalings exist from the start: `create` changes nothing.
    KS_Scaling* getScalingByDDKey(const ZnCXString& key, bool create) override;

private:
    static constexpr int kNamedCount = 12;
    std::vector<std::unique_ptr<KsCHostScaling>> scalings_;
    KsCHostScaling* named_[kNamedCount];
    std::unordered_map<std::string, KsCHostScaling*> byValue_;
    std::unordered_map<std::string, KsCHostScaling*> byKey_;
};
