#include "KsCHostCodeModel.h"
#include "KsCHostTestConfig.h"

#include <gtest/gtest.h>

#include <functional>

namespace {

// Records what the symbol database hands a visitor: "P:name" for parameterised symbols,
// "U:name" for unparameterised ones.
class Recorder : public KS_SmbDBObjVisitor {
public:
    void visit(KS_SmbDBParamObj* object) override {
        seen.push_back("P:" + object->getParamSymbol()->getName().str());
    }
    void visit(KS_SmbDBUnparamObj* object) override {
        seen.push_back("U:" + object->getUnparamSymbol()->getName().str());
    }
    std::vector<std::string> seen;
};

class KsCHostSymbolTest : public ::testing::Test {
protected:
    KsCIcFileId* file(const char* module) {
        KsCIcFileId* f = nullptr;
        EXPECT_TRUE(model.applicationServer().demandCgOwnedCFile(
            model.applicationServer().demandUserSubAppl(), KsCCIdentifier(module), nullptr, f));
        return f;
    }
    KS_DataType* type(const char* name) { return model.dataTypeServer().find(name); }
    KsCVarClassId* varClass(const char* name) {
        return model.classServer().demandVariableClass(name, nullptr, nullptr);
    }
    KsCFcnClassId* fcnClass(const char* name) {
        return model.classServer().demandFunctionClass(name, nullptr, nullptr);
    }
    KS_Scaling* defaultScaling() { return model.scaleServer().getDefaultScaling(); }
    KsCUnparamSymbol* variable(const char* name, const char* typeName = "sint16") {
        return model.getVariable()->create(name, 0x200000, type(typeName), defaultScaling(),
                                           varClass("GlobalVar"), nullptr);
    }
    KsCParamSymbol* function(KsCIcFileId* f, const char* name) {
        return model.getFunction()->createFunctionAndDepStt(
            f, name, 0x200000, type("void"), defaultScaling(), fcnClass("StdFunction"), nullptr);
    }
    static const KsCHostSymbolData& data(KsCSymbol* symbol) {
        return *KsCHostSymbolData::of(symbol);
    }
    static std::vector<std::string> names(const std::vector<KsCSymbol*>& symbols) {
        std::vector<std::string> out;
        for (KsCSymbol* s : symbols)
            out.push_back(s->getName().str());
        return out;
    }

    KsCHostCodeModel model{KsCHostConfig::embeddedDefault()};
};

TEST_F(KsCHostSymbolTest, AVariableKeepsWhatItWasCreatedWith) {
    KS_Scaling* scaling = model.scaleServer().getScaling(0.5, 2, nullptr);
    KsCUnparamSymbol* v = model.getVariable()->create("speed", 0x42, type("uint16"), scaling,
                                                      varClass("StaticGlobalVar"), nullptr);
    EXPECT_EQ(v->getName(), "speed");
    EXPECT_EQ(v->getDataType(), type("uint16"));
    EXPECT_EQ(v->getVarClassId(), varClass("StaticGlobalVar"));
    EXPECT_EQ(v->getSymbolTable(), nullptr);
    EXPECT_EQ(v->asUnparamSymbol(), v);
    EXPECT_EQ(v->asParamSymbol(), nullptr);
    EXPECT_EQ(v->getNrOfComponents(), 0);
    const KsCHostSymbolData& d = data(v);
    EXPECT_EQ(d.flags(), 0x42u);
    EXPECT_EQ(d.scaling(), scaling);
    EXPECT_EQ(d.listingKind(), KsEHostListingKind::Variable);
    EXPECT_FALSE(d.hasInit());
    EXPECT_FALSE(d.hasRange());
    EXPECT_FALSE(d.hasSmbKind());
}

TEST_F(KsCHostSymbolTest, ServersGiveEachSymbolItsListingKind) {
    KsCIcFileId* f = file("a");
    KS_DataType* t = type("sint16");
    KsCVarClassId* c = varClass("GlobalVar");
    struct Case {
        KsCSymbol* symbol;
        KsEHostListingKind kind;
    } cases[] = {
        {model.getVariable()->create("v", 0, t, defaultScaling(), c, nullptr),
         KsEHostListingKind::Variable},
        {model.getVariable()->createAndInitScalar("i", 0, t, defaultScaling(), c, 1, nullptr),
         KsEHostListingKind::Variable},
        {model.getMacro()->create("M", 0, "(1)", "one", t, defaultScaling(), c, nullptr),
         KsEHostListingKind::Macro},
        {model.getFunction()->createParamSymbol("p", 0, t, defaultScaling(), varClass("InputParam"),
                                                nullptr),
         KsEHostListingKind::Parameter},
        {function(f, "fn"), KsEHostListingKind::Function},
        {model.getParamMacro()->createParamMacroAndDepStt("PM", 0, t, defaultScaling(),
                                                          fcnClass("MacroFunction"), f, nullptr),
         KsEHostListingKind::ParamMacro},
    };
    for (const Case& c : cases)
        EXPECT_EQ(data(c.symbol).listingKind(), c.kind) << c.symbol->getName().str();
    EXPECT_EQ(data(cases[2].symbol).definition(), "(1)");
    EXPECT_EQ(data(cases[2].symbol).comment(), "one");
    EXPECT_TRUE(cases[4].symbol->asParamSymbol()->isFunction());
    EXPECT_FALSE(cases[5].symbol->asParamSymbol()->isFunction());
}

TEST_F(KsCHostSymbolTest, InitialValuesKeepTheirOrder) {
    const double vector[] = {1, -2, 3.5};
    const double matrix[] = {1, 2, 3, 4, 5, 6};
    KsCUnparamSymbol* s = model.getVariable()->createAndInitScalar(
        "s", 0, type("sint16"), defaultScaling(), varClass("GlobalVar"), -7.25, nullptr);
    KsCUnparamSymbol* v = model.getVariable()->createAndInitVector(
        "v", 0, type("sint16[3]"), defaultScaling(), varClass("GlobalVar"), vector, 3, nullptr);
    KsCUnparamSymbol* m = model.getVariable()->createAndInitMatrix(
        "m", 0, type("sint16[2][3]"), defaultScaling(), varClass("GlobalVar"), matrix, 6, nullptr);
    EXPECT_EQ(data(s).initValues(), std::vector<double>{-7.25});
    EXPECT_EQ(data(v).initValues(), (std::vector<double>{1, -2, 3.5}));
    EXPECT_EQ(data(m).initValues(), (std::vector<double>{1, 2, 3, 4, 5, 6}));
}

TEST_F(KsCHostSymbolTest, TheInitializerChecksTheShape) {
    KsCSymbolInitializer initializer(model.container());
    KsCUnparamSymbol* scalar = variable("s");
    KsCUnparamSymbol* vector = variable("v", "sint16[3]");
    KsCUnparamSymbol* matrix = variable("m", "sint16[2][2]");
    const double values[] = {1, 2, 3, 4};

    EXPECT_TRUE(initializer.initScalarWithValue(scalar, 5, true, 0));
    EXPECT_EQ(data(scalar).initValues(), std::vector<double>{5});
    EXPECT_FALSE(initializer.initScalarWithValue(vector, 5, true, 0));

    EXPECT_FALSE(initializer.initVectorWithValues(vector, values, 2, 1));
    EXPECT_FALSE(initializer.initVectorWithValues(vector, values, 4, 1));
    EXPECT_FALSE(initializer.initVectorWithValues(scalar, values, 1, 1));
    EXPECT_FALSE(initializer.initVectorWithValues(matrix, values, 4, 1));
    EXPECT_FALSE(data(vector).hasInit());
    EXPECT_TRUE(initializer.initVectorWithValues(vector, values, 3, 1));
    EXPECT_EQ(data(vector).initValues(), (std::vector<double>{1, 2, 3}));

    EXPECT_FALSE(initializer.initMatrixWithValues(matrix, values, 3, 1));
    EXPECT_FALSE(initializer.initMatrixWithValues(vector, values, 3, 1));
    EXPECT_TRUE(initializer.initMatrixWithValues(matrix, values, 4, 1));
    EXPECT_EQ(data(matrix).initValues(), (std::vector<double>{1, 2, 3, 4}));
}

TEST_F(KsCHostSymbolTest, RangesMustHaveTheSymbolsShape) {
    const double lows[] = {-1, -2, -3, -4, -5, -6};
    const double highs[] = {1, 2, 3, 4, 5, 6};
    struct Case {
        const char* type;
        int rows, columns;
        bool accepted;
    } cases[] = {
        {"sint16", 1, 1, true},        {"sint16", 1, 2, false},       {"sint16", 2, 1, false},
        {"sint16*", 1, 1, true},       {"sint16[3]", 1, 3, true},     {"sint16[3]", 3, 1, false},
        {"sint16[3]", 1, 2, false},    {"sint16[3]", 1, 1, false},    {"sint16[2][3]", 2, 3, true},
        {"sint16[2][3]", 3, 2, false}, {"sint16[2][3]", 1, 6, false},
    };
    for (const Case& c : cases) {
        KsCUnparamSymbol* symbol = variable("r", c.type);
        KsCConstArray2 min{c.rows, c.columns, lows};
        KsCConstArray2 max{c.rows, c.columns, highs};
        EXPECT_EQ(KsCSmbConstRangeBuilder::setUserDefinedRanges(symbol, min, max), c.accepted)
            << c.type << " " << c.rows << "x" << c.columns;
        EXPECT_EQ(data(symbol).hasRange(), c.accepted) << c.type;
        if (c.accepted) {
            std::size_t n = static_cast<std::size_t>(c.rows * c.columns);
            EXPECT_EQ(data(symbol).minValues(), std::vector<double>(lows, lows + n));
            EXPECT_EQ(data(symbol).maxValues(), std::vector<double>(highs, highs + n));
        }
    }
    // MIN and MAX must agree with each other as well.
    KsCUnparamSymbol* vector = variable("w", "sint16[2]");
    EXPECT_FALSE(
        KsCSmbConstRangeBuilder::setUserDefinedRanges(vector, {1, 2, lows}, {1, 3, highs}));
    // A function's range is its return value's.
    KsCParamSymbol* f = model.getFunction()->createFunctionAndDepStt(
        file("a"), "f", 0, type("sint16"), defaultScaling(), fcnClass("StdFunction"), nullptr);
    EXPECT_TRUE(KsCSmbConstRangeBuilder::setUserDefinedRanges(f, {1, 1, lows}, {1, 1, highs}));
    EXPECT_EQ(data(f).minValues(), std::vector<double>{-1});
}

TEST_F(KsCHostSymbolTest, MarksRememberWhetherTheyWereSetOrCleared) {
    KsCUnparamSymbol* v = variable("v");
    const KsCHostSymbolData& d = data(v);
    for (int m = 0; m < KS_HOST_MARK_COUNT; ++m)
        EXPECT_EQ(d.mark(static_cast<KsEHostMark>(m)), KsEHostMarkState::Unset);
    v->markAsRootInterface();
    v->unmarkSfEntryVar();
    v->markAsSideEffectFreeFunction();
    v->unmarkSideEffectFreeFunction();
    v->markAsRtosGetCounterValueFcn();
    v->markAsConversionTempVar();
    EXPECT_EQ(d.mark(KS_HOST_MARK_ROOT_INTERFACE), KsEHostMarkState::Marked);
    EXPECT_EQ(d.mark(KS_HOST_MARK_SF_ENTRY_VAR), KsEHostMarkState::Unmarked);
    EXPECT_EQ(d.mark(KS_HOST_MARK_SIDE_EFFECT_FREE_FUNCTION), KsEHostMarkState::Unmarked);
    EXPECT_EQ(d.mark(KS_HOST_MARK_RTOS_GET_COUNTER_VALUE_FCN), KsEHostMarkState::Marked);
    EXPECT_EQ(d.mark(KS_HOST_MARK_CONVERSION_TEMP_VAR), KsEHostMarkState::Marked);
    v->unmarkConversionTempVar();
    EXPECT_EQ(d.mark(KS_HOST_MARK_CONVERSION_TEMP_VAR), KsEHostMarkState::Unmarked);

    EXPECT_FALSE(d.hasSmbKind());
    v->setKind(SMB_UNDEFINED_SYMBOL_KIND);
    EXPECT_TRUE(d.hasSmbKind()) << "a kind set to the undefined one is still set";
    v->setKind(SMB_TEMP_VAR);
    EXPECT_EQ(d.smbKind(), SMB_TEMP_VAR);
}

TEST_F(KsCHostSymbolTest, AStructuredVariableHasOneComponentPerStructureComponent) {
    KsCHostDataType* inner =
        model.dataTypeServer().demandStruct("In", {{"a", model.dataTypeServer().find("uint8")}});
    KsCHostDataType* outer = model.dataTypeServer().demandStruct(
        "Out", {{"x", model.dataTypeServer().find("sint16")},
                {"in", inner},
                {"v", model.dataTypeServer().find("sint16[2]")}});
    KsCUnparamSymbol* s = model.getVariable()->create("s", 7, outer, defaultScaling(),
                                                      varClass("GlobalVar"), nullptr);
    ASSERT_EQ(s->getNrOfComponents(), 3);
    std::vector<std::string> walked;
    for (KsCCompSymbolIterator it(s); it.hasNext();) {
        KsCUnparamSymbol* c = it.next();
        walked.push_back(c->getName().str() + ":" + c->getDataType()->getName().str());
        EXPECT_EQ(c->getVarClassId(), varClass("GlobalVar"));
    }
    EXPECT_EQ(walked, (std::vector<std::string>{"x:sint16", "in:struct In", "v:sint16[2]"}));
    ASSERT_EQ(s->getComponent(1)->getNrOfComponents(), 1);
    EXPECT_EQ(s->getComponent(1)->getComponent(0)->getName(), "a");
    EXPECT_EQ(s->getComponent(3), nullptr);
    EXPECT_EQ(s->getComponent(-1), nullptr);
    // Components are no objects of the database.
    EXPECT_EQ(model.symbolDB().named("x"), nullptr);
}

TEST_F(KsCHostSymbolTest, SymbolTablesIndexTheirMembersByName) {
    KsCSymbolTable* table = file("a")->getFile()->getStt()->getSymbolTable();
    KsCUnparamSymbol* x1 = variable("x");
    KsCUnparamSymbol* y = variable("y");
    KsCUnparamSymbol* x2 = variable("x");
    table->addMember(x1);
    table->addMember(y);
    table->addMember(x2);
    table->addMember(x1);
    EXPECT_EQ(names(table->getMembers()), (std::vector<std::string>{"x", "y", "x"}));
    ASSERT_NE(table->findMembers("x"), nullptr);
    EXPECT_EQ(*table->findMembers("x"), (std::vector<KsCSymbol*>{x1, x2}));
    EXPECT_EQ(table->findMembers("z"), nullptr);
    EXPECT_EQ(x1->getSymbolTable(), table);

    EXPECT_TRUE(table->removeMember(x1));
    EXPECT_FALSE(table->removeMember(x1));
    EXPECT_EQ(*table->findMembers("x"), (std::vector<KsCSymbol*>{x2}));
    EXPECT_EQ(names(table->getMembers()), (std::vector<std::string>{"y", "x"}));
    EXPECT_TRUE(table->removeMember(x2));
    EXPECT_EQ(table->findMembers("x"), nullptr);
}

TEST_F(KsCHostSymbolTest, ASymbolBelongsToTheTableItEnteredFirstUntilItLeavesIt) {
    KsCIcFile* a = file("a")->getFile();
    KsCSymbolTable* own = a->getStt()->getSymbolTable();
    KsCSymbolTable* header = a->getAssociatedCHeader()->getFile()->getStt()->getSymbolTable();
    KsCParamSymbol* f = function(file("a"), "f");
    EXPECT_EQ(f->getSymbolTable(), own);
    // Handed over to the header, as model functions are: the header is its table now, and
    // entering it into its old table again keeps it there.
    EXPECT_TRUE(own->removeMember(f));
    EXPECT_EQ(f->getSymbolTable(), nullptr);
    header->addMember(f);
    own->addMember(f);
    EXPECT_EQ(f->getSymbolTable(), header);
    EXPECT_EQ(names(header->getMembers()), std::vector<std::string>{"f"});
    EXPECT_EQ(names(own->getMembers()), std::vector<std::string>{"f"});
    EXPECT_FALSE(header->removeMember(nullptr));
}

TEST_F(KsCHostSymbolTest, AFunctionsTablesNestLocalsInParametersInTheFile) {
    KsCIcFileId* a = file("a");
    KsCParamSymbol* f = function(a, "f");
    // A prototype belongs to its file at once; entering it again changes nothing.
    KsCSymbolTable* fileTable = a->getFile()->getStt()->getSymbolTable();
    fileTable->addMember(f);
    EXPECT_EQ(names(fileTable->getMembers()), std::vector<std::string>{"f"});

    KsCCodeStmTable* body = f->getBodySTT();
    ASSERT_NE(body, nullptr);
    EXPECT_EQ(f->getBodySTT(), body);
    KS_StatementTable* parameters = body->getParentStatementTable();
    ASSERT_NE(parameters, nullptr);
    EXPECT_EQ(parameters->getParentStatementTable(), a->getFile()->getStt());
    EXPECT_EQ(body->getSymbolTable()->getFile(), a);
    EXPECT_EQ(parameters->getSymbolTable()->getFile(), a);

    KsCUnparamSymbol* p1 = model.getFunction()->createParamSymbol(
        "first", 0, type("sint16"), defaultScaling(), varClass("InputParam"), nullptr);
    KsCUnparamSymbol* p2 = model.getFunction()->createParamSymbol(
        "second", 0, type("sint16*"), defaultScaling(), varClass("OutputParam"), nullptr);
    EXPECT_TRUE(model.getFunction()->addToParameterList(f, p1));
    EXPECT_TRUE(model.getFunction()->addToParameterList(f, p2));
    EXPECT_FALSE(model.getFunction()->addToParameterList(f, p1));
    EXPECT_EQ(f->getNrOfParameters(), 2);
    EXPECT_EQ(f->getParameter(0), p1);
    EXPECT_EQ(f->getParameter(1), p2);
    EXPECT_EQ(f->getParameter(2), nullptr);
    EXPECT_EQ(names(parameters->getSymbolTable()->getMembers()),
              (std::vector<std::string>{"first", "second"}));
    EXPECT_EQ(p1->getSymbolTable(), parameters->getSymbolTable());
}

TEST_F(KsCHostSymbolTest, EachServerAddsParametersOnlyToItsOwnKind) {
    KsCIcFileId* a = file("a");
    KsCParamSymbol* f = function(a, "f");
    KsCParamSymbol* macro = model.getParamMacro()->createParamMacroAndDepStt(
        "M", 0, type("sint16"), defaultScaling(), fcnClass("MacroFunction"), a, nullptr);
    KsCUnparamSymbol* p = model.getFunction()->createParamSymbol(
        "p", 0, type("sint16"), defaultScaling(), varClass("InputParam"), nullptr);
    EXPECT_FALSE(model.getParamMacro()->addToParameterList(f, p));
    EXPECT_FALSE(model.getFunction()->addToParameterList(macro, p));
    EXPECT_FALSE(model.getFunction()->addToParameterList(nullptr, p));
    EXPECT_FALSE(model.getFunction()->addToParameterList(f, nullptr));
    EXPECT_TRUE(model.getParamMacro()->addToParameterList(macro, p));
    EXPECT_EQ(macro->getNrOfParameters(), 1);
    EXPECT_EQ(f->getNrOfParameters(), 0);
}

TEST_F(KsCHostSymbolTest, ExternClassAndStateAreKept) {
    auto* f = dynamic_cast<KsCHostParamSymbol*>(function(file("a"), "f"));
    EXPECT_FALSE(f->externClassSet());
    EXPECT_FALSE(f->externStateSet());
    f->setExternSmbClass(nullptr);
    f->setExtSmbClassState(3);
    EXPECT_TRUE(f->externClassSet());
    EXPECT_EQ(f->externClass(), nullptr);
    EXPECT_EQ(f->externState(), 3);
}

TEST_F(KsCHostSymbolTest, TheDatabaseVisitsEverySymbolInCreationOrder) {
    KsCIcFileId* a = file("a");
    variable("x");
    function(a, "f");
    model.getFunction()->createParamSymbol("p", 0, type("sint16"), defaultScaling(),
                                           varClass("InputParam"), nullptr);
    variable("x");
    model.getMacro()->create("M", 0, "", "", type("sint16"), defaultScaling(), varClass("MacroVar"),
                             nullptr);
    Recorder all;
    KS_SymbolDB::forallObj(all);
    EXPECT_EQ(all.seen, (std::vector<std::string>{"U:x", "P:f", "U:p", "U:x", "U:M"}));
    Recorder named;
    KS_SymbolDB::forallObjNamed("x", named);
    EXPECT_EQ(named.seen, (std::vector<std::string>{"U:x", "U:x"}));
    Recorder function;
    KS_SymbolDB::forallObjNamed("f", function);
    EXPECT_EQ(function.seen, std::vector<std::string>{"P:f"});
    Recorder none;
    KS_SymbolDB::forallObjNamed("nothing", none);
    EXPECT_TRUE(none.seen.empty());
}

TEST_F(KsCHostSymbolTest, TheDatabaseIsThatOfTheCurrentModel) {
    variable("outer");
    {
        KsCHostCodeModel inner{KsCHostConfig::embeddedDefault()};
        inner.getVariable()->create("inner", 0, inner.dataTypeServer().find("int"),
                                    inner.scaleServer().getDefaultScaling(), nullptr, nullptr);
        Recorder seen;
        KS_SymbolDB::forallObj(seen);
        EXPECT_EQ(seen.seen, std::vector<std::string>{"U:inner"});
    }
    // The inner model's end leaves no database current; the outer one is not reinstated.
    Recorder after;
    KS_SymbolDB::forallObj(after);
    EXPECT_TRUE(after.seen.empty());
}

TEST_F(KsCHostSymbolTest, AVisitorMayCreateSymbolsWhileItVisits) {
    struct Creating : KS_SmbDBObjVisitor {
        std::function<void()> create;
        int visits = 0;
        void visit(KS_SmbDBParamObj*) override { ++visits; }
        void visit(KS_SmbDBUnparamObj*) override {
            ++visits;
            create();
        }
    } visitor;
    visitor.create = [this] { variable("x"); };
    variable("x");
    KS_SymbolDB::forallObjNamed("x", visitor);
    EXPECT_EQ(visitor.visits, 1);
    KS_SymbolDB::forallObj(visitor);
    EXPECT_EQ(visitor.visits, 3);
    EXPECT_EQ(model.symbolDB().named("x")->size(), 4u);
}

TEST_F(KsCHostSymbolTest, CodeBlocksAreRecordedOnce) {
    KsCParamSymbol* f = function(file("a"), "f");
    KsCParamSymbol* g = function(file("a"), "g");
    model.getCodeBlockDB()->demandCodeBlock(g);
    model.getCodeBlockDB()->demandCodeBlock(f);
    model.getCodeBlockDB()->demandCodeBlock(g);
    EXPECT_EQ(model.codeBlockDB().functions(), (std::vector<KsCParamSymbol*>{g, f}));
    EXPECT_TRUE(model.codeBlockDB().hasCodeBlock(f));
}

TEST_F(KsCHostSymbolTest, IterationContextsAreNumberedInCreationOrder) {
    KsCCvIterConFactory* factory = model.getCvIterContextFactory();
    KsCCvIterContext* first = factory->create(0, 15);
    KsCCvIterContext* second = factory->create(-2, 3);
    EXPECT_NE(first, second);
    EXPECT_EQ(first->toString(), "IterContext#1[0:15]");
    EXPECT_EQ(second->toString(), "IterContext#2[-2:3]");
    EXPECT_EQ(model.iterContexts().contexts().size(), 2u);
}

} // namespace
