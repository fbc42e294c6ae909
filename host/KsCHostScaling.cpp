#include "KsCHostScaling.h"

KS_Scaling::~KS_Scaling() = default;

KsCHostScaling::KsCHostScaling(std::string name) : kind_(Kind::Named), name_(std::move(name)) {}

KsCHostScaling::KsCHostScaling(Kind kind, int rows, int columns, std::vector<double> lsbs,
                               std::vector<double> offsets)
    : kind_(kind), rows_(rows), columns_(columns), lsbs_(std::move(lsbs)),
      offsets_(std::move(offsets)) {}

KsCHostScaling::~KsCHostScaling() = default;
