#include "KsCHostScaleServer.h"

#include "KsCHostConfig.h"

#include <cstring>

KS_ScaleServer::~KS_ScaleServer() = default;

namespace {

const char* const kNamedScalings[] = {
    "DEFAULT_SCALING",
    "UNDEFINED_SCALING",
    "ADAPTIVE_SCALING",
    "DEFAULT_BITFIELD_SCALING",
    "DEFAULT_FLOAT_SCALING",
    "DEFAULT_BOOL_SCALING",
    "DEFAULT_MATHFUNC_SCALING",
    "DEFAULT_POINTER_SCALING",
    "DEFAULT_STATEFLOW_SCALING",
    "DEFAULT_VOID_SCALING",
    "DEFAULT_ENUMCOMPONENT_SCALING",
    "DEFAULT_ENUM_SCALING",
};

// The bytes of the values: equal scalings give equal keys, -0 and 0 stay apart.
void appendBytes(std::string& key, const void* data, std::size_t size) {
    key.append(static_cast<const char*>(data), size);
}

} // namespace

KsCHostScaleServer::KsCHostScaleServer(const KsCHostConfig& config) {
    static_assert(sizeof(kNamedScalings) / sizeof(kNamedScalings[0]) == kNamedCount);
    for (int i = 0; i < kNamedCount; ++i) {
        scalings_.push_back(std::make_unique<KsCHostScaling>(kNamedScalings[i]));
        named_[i] = scalings_.back().get();
    }
    for (const KsCHostScalingConfig& s : config.scalings) {
        if (s.lsbs.empty() || s.lsbs.size() != s.offsets.size())
            continue;
        int count = static_cast<int>(s.lsbs.size());
        KsCHostScaling* scaling = s.perElement ? demand(KsCHostScaling::Kind::Vector, 1, count,
                                                        s.lsbs.data(), s.offsets.data(), true)
                                               : demand(KsCHostScaling::Kind::Scalar, 1, 1,
                                                        s.lsbs.data(), s.offsets.data(), false);
        byKey_.emplace(s.key, scaling);
    }
}

KsCHostScaleServer::~KsCHostScaleServer() = default;

KsCHostScaling* KsCHostScaleServer::demand(KsCHostScaling::Kind kind, int rows, int columns,
                                           const double* lsbs, const double* offsets,
                                           bool perElement) {
    if (rows < 1 || columns < 1 || !lsbs || !offsets)
        return nullptr;
    std::size_t count = perElement ? static_cast<std::size_t>(rows) * columns : 1;
    std::string key;
    key += static_cast<char>(kind);
    appendBytes(key, &rows, sizeof rows);
    appendBytes(key, &columns, sizeof columns);
    appendBytes(key, lsbs, count * sizeof(double));
    appendBytes(key, offsets, count * sizeof(double));
    KsCHostScaling*& slot = byValue_[key];
    if (!slot) {
        scalings_.push_back(std::make_unique<KsCHostScaling>(
            kind, rows, columns, std::vector<double>(lsbs, lsbs + count),
            std::vector<double>(offsets, offsets + count)));
        slot = scalings_.back().get();
    }
    return slot;
}

KS_Scaling* KsCHostScaleServer::getScaling(double lsb, double offset, KsCSrcRef*) {
    return demand(KsCHostScaling::Kind::Scalar, 1, 1, &lsb, &offset, false);
}

KS_Scaling* KsCHostScaleServer::getVector(int width, double lsb, double offset, KsCSrcRef*) {
    return demand(KsCHostScaling::Kind::Vector, 1, width, &lsb, &offset, false);
}

KS_Scaling* KsCHostScaleServer::getMatrix(int rows, int columns, double lsb, double offset,
                                          KsCSrcRef*) {
    return demand(KsCHostScaling::Kind::Matrix, rows, columns, &lsb, &offset, false);
}

KS_Scaling* KsCHostScaleServer::getScaling(int width, const double* lsbs, const double* offsets,
                                           KsCSrcRef*) {
    return demand(KsCHostScaling::Kind::Vector, 1, width, lsbs, offsets, true);
}

KS_Scaling* KsCHostScaleServer::getScaling(int rows, int columns, const double* lsbs,
                                           const double* offsets, KsCSrcRef*) {
    return demand(KsCHostScaling::Kind::Matrix, rows, columns, lsbs, offsets, true);
}

KS_Scaling* KsCHostScaleServer::getScalingByDDKey(const ZnCXString& key, bool) {
    auto found = byKey_.find(key.str());
    return found == byKey_.end() ? nullptr : found->second;
}
