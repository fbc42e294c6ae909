#include "KsCHostOperation.h"

KS_OpOperator::~KS_OpOperator() = default;
KS_Range::~KS_Range() = default;
KS_Operation::~KS_Operation() = default;
KS_ParamAccess::~KS_ParamAccess() = default;
KsCHostOpOperator::~KsCHostOpOperator() = default;
KsCHostOpOperatorServer::~KsCHostOpOperatorServer() = default;
KsCHostRange::~KsCHostRange() = default;
KsCHostRangeServer::~KsCHostRangeServer() = default;
KsCHostParamAccess::~KsCHostParamAccess() = default;
KsCHostOperationData::~KsCHostOperationData() = default;
KsCHostOperation::~KsCHostOperation() = default;
KsCHostCall::~KsCHostCall() = default;
KsCHostAccess::~KsCHostAccess() = default;

KsCHostOpOperatorServer::KsCHostOpOperatorServer() {
    // In the order of Index.
    static constexpr struct {
        const char* name;
        KsEOpOperatorGroup group;
    } kOperators[] = {
        {"*", KS_OPGROUP_ARITHMETIC},    {"/", KS_OPGROUP_ARITHMETIC},
        {"%", KS_OPGROUP_ARITHMETIC},    {"+", KS_OPGROUP_ARITHMETIC},
        {"-", KS_OPGROUP_ARITHMETIC},    {"<<", KS_OPGROUP_SHIFT},
        {">>", KS_OPGROUP_SHIFT},        {"<", KS_OPGROUP_LOGICAL},
        {">", KS_OPGROUP_LOGICAL},       {"<=", KS_OPGROUP_LOGICAL},
        {">=", KS_OPGROUP_LOGICAL},      {"==", KS_OPGROUP_LOGICAL},
        {"!=", KS_OPGROUP_LOGICAL},      {"&", KS_OPGROUP_BITWISE},
        {"^", KS_OPGROUP_BITWISE},       {"|", KS_OPGROUP_BITWISE},
        {"&&", KS_OPGROUP_LOGICAL},      {"||", KS_OPGROUP_LOGICAL},
        {"=", KS_OPGROUP_ASSIGNMENT},    {"+=", KS_OPGROUP_ASSIGNMENT},
        {"-=", KS_OPGROUP_ASSIGNMENT},   {"*=", KS_OPGROUP_ASSIGNMENT},
        {"/=", KS_OPGROUP_ASSIGNMENT},   {"&=", KS_OPGROUP_ASSIGNMENT},
        {"|=", KS_OPGROUP_ASSIGNMENT},   {",", KS_OPGROUP_SEQUENCE},
        {"cast", KS_OPGROUP_CAST},       {"?:", KS_OPGROUP_CONDITIONAL},
        {"post++", KS_OPGROUP_INC_DEC},  {"post--", KS_OPGROUP_INC_DEC},
        {"pre++", KS_OPGROUP_INC_DEC},   {"pre--", KS_OPGROUP_INC_DEC},
        {"~", KS_OPGROUP_BIT_NOT},       {"!", KS_OPGROUP_NOT},
        {"neg", KS_OPGROUP_UNARY_MINUS},
    };
    static_assert(sizeof kOperators / sizeof kOperators[0] == kCount);
    for (const auto& o : kOperators)
        operators_.push_back(std::make_unique<KsCHostOpOperator>(o.name, o.group));
}

const KsCHostOpOperator* KsCHostOpOperatorServer::find(std::string_view name) const {
    for (const auto& op : operators_)
        if (op->name() == name)
            return op.get();
    return nullptr;
}

KsCHostRangeServer::KsCHostRangeServer() {
    auto pointer = std::make_unique<KsCHostRange>(true);
    pointer->setIntegerLowerLimit(0);
    pointer->setIntegerUpperLimit((std::int64_t{1} << 32) - 1);
    ranges_.push_back(std::move(pointer));
}

KS_Range* KsCHostRangeServer::createRange() {
    ranges_.push_back(std::make_unique<KsCHostRange>());
    return ranges_.back().get();
}

// Process-wide, like the host's own: the module compares accesses by identity.
KS_ParamAccess* KS_ParamAccess::createReadOnly() {
    static KsCHostParamAccess access("R");
    return &access;
}

KS_ParamAccess* KS_ParamAccess::createReadWrite() {
    static KsCHostParamAccess access("RW");
    return &access;
}

KS_ParamAccess* KS_ParamAccess::createWriteOnly() {
    static KsCHostParamAccess access("W");
    return &access;
}

KS_ParamAccess* KS_ParamAccess::createWriteOnlyOutput() {
    static KsCHostParamAccess access("W_OUTPUT");
    return &access;
}

KS_ParamAccess* KS_ParamAccess::createReadWriteOutput() {
    static KsCHostParamAccess access("RW_OUTPUT");
    return &access;
}

KsCHostOperationData::KsCHostOperationData(Kind kind, KS_OpOperator* op,
                                           std::vector<KS_ExprLocation*> operands,
                                           KS_DataType* type, KS_Scaling* scaling, KS_Range* range,
                                           unsigned flags, KsEHostOpLevel level, KsCSrcRef* srcRef)
    : kind_(kind), op_(op), operands_(std::move(operands)), type_(type), scaling_(scaling),
      initialType_(type), initialScaling_(scaling), range_(range), flags_(flags), level_(level),
      srcRef_(srcRef) {}

KsCHostOperationData* KsCHostOperationData::of(KS_Operation* operation) {
    return dynamic_cast<KsCHostOperationData*>(operation);
}

const KsCHostOperationData* KsCHostOperationData::of(const KS_Operation* operation) {
    return dynamic_cast<const KsCHostOperationData*>(operation);
}

const KsCHostOpOperator* KsCHostOperationData::hostOperator() const {
    return dynamic_cast<const KsCHostOpOperator*>(op_);
}

KsCHostCall::KsCHostCall(KsCParamSymbol* function, bool macro, std::vector<Argument> arguments,
                         KS_DataType* type, KS_Scaling* scaling, KS_Range* range,
                         KsEHostOpLevel level, KsCSrcRef* srcRef)
    : KsCHostOperation(Kind::Call, nullptr, values(arguments), type, scaling, range, 0, level,
                       srcRef),
      function_(function), macro_(macro), arguments_(std::move(arguments)) {}

std::vector<KS_ExprLocation*> KsCHostCall::values(const std::vector<Argument>& arguments) {
    std::vector<KS_ExprLocation*> values;
    values.reserve(arguments.size());
    for (const Argument& a : arguments)
        values.push_back(a.value);
    return values;
}

KsCHostAccess::KsCHostAccess(KsEHostAccessForm form, KsCSymbol* symbol,
                             std::vector<KS_ExprLocation*> operands, KS_DataType* type,
                             KS_Scaling* scaling, KsCSrcRef* srcRef)
    : KsCHostOperationBase(Kind::Access, nullptr, std::move(operands), type, scaling, nullptr, 0,
                           KsEHostOpLevel::None, srcRef),
      form_(form), symbol_(symbol) {}

KsEHostMarkState KsCHostAccess::strictness(int level) const {
    for (const auto& [marked, state] : strictness_)
        if (marked == level)
            return state;
    return KsEHostMarkState::Unset;
}

void KsCHostAccess::setStrictness(int level, KsEHostMarkState state) {
    for (auto& [marked, current] : strictness_)
        if (marked == level) {
            current = state;
            return;
        }
    strictness_.emplace_back(level, state);
}
