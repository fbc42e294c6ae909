// The operation factory wired to the real module servers over the stand-in host's embedded
// configuration, with helpers that make operands of given types and scalings, parse annotations
// from text and read back what the code model holds.
#pragma once

#include "ItfAdditionalInfo/KsCItfAdditionalInfoEvaluator.h"
#include "ItfDataType/KsCItfDataTypeServer.h"
#include "ItfExprLocation/KsCItfExprLocationDB.h"
#include "ItfICodeFactory/KsCItfICodeFactory.h"
#include "ItfIterationContext/KsCItfIterationContextServer.h"
#include "ItfParseFixture.h"
#include "ItfSrcRef/KsCItfSrcRef.h"
#include "ItfSymbolClass/KsCItfSymbolClassServer.h"
#include "ItfSyntaxTree/KsCItfSyntaxTree.h"
#include "ItfVariableServer/KsCItfVariableServer.h"
#include "KsCHostCodeModel.h"
#include "KsCHostOptions.h"

#include <string>
#include <vector>

class ItfICodeFactoryTest : public ItfParseTest {
protected:
    using Unary = KsCItfICodeFactory::UnaryOperator;
    using Binary = KsCItfICodeFactory::BinaryOperator;

    struct Parameter {
        const char* name;
        const char* type; // "sint16", "sint16*"
        const char* varClass;
    };

    ItfICodeFactoryTest() : model(KsCHostConfig::embeddedDefault()) {
        for (const char* name : {"sint64", "uint64", "float64"})
            registry.addTypeName(name);
        KS_ICodeFactoryContainer* c = model.container();
        classes.init(c->getVarClassServer(), c->getSmbClassServer()->getFcnClassServer(),
                     c->getSmbClassServer()->getClassMutator(), &srcRefServer, &messages_);
        types.init(c->getBaseTypeServer(), c->getDataTypeServer(), c->getNumTypeServer(),
                   c->getDataTypeServer()->getPointerServer(), &srcRefServer, &messages_);
        evaluator.init(&messages_, c->getScaleServer(), &classes, &srcRefServer, &types);
        database.init();
        variables.init(nullptr, nullptr, nullptr, nullptr, nullptr, nullptr, &messages_, nullptr,
                       nullptr, &srcRefServer, &evaluator, nullptr, c);
        contexts.init(&messages_, c->getCvIterContextFactory(), &variables);
        wire(icf, c->getQSOFactories()->getVectorSliceBaseFactory());
        position = factory.createSrcRef();
        position->setPosition(factory.intern("t"), 7, 3, factory.intern("x"));
        file = model.applicationServer().demandModuleFile("t");
    }
    ~ItfICodeFactoryTest() override {
        icf.exit();
        contexts.exit();
        variables.exit();
        database.exit();
        evaluator.exit();
        types.exit();
        classes.exit();
    }

    void wire(KsCItfICodeFactory& target, KS_QSOVectorSliceBaseFactory* slices) {
        KS_ICodeFactoryContainer* c = model.container();
        KS_OpFactories* ops = c->getOpFactories();
        KS_QSOFactories* qso = c->getQSOFactories();
        target.init(c->getStatementTableFactory(), c->getExprLocFactory(), ops->getArithmetics(),
                    c->getOpOperatorServer(), c->getStatementFactory(), c, c->getNumTypeServer(),
                    c->getScaleServer(), qso->getBaseFactory(), &messages_, &types,
                    c->getBaseTypeServer(), c->getStdCFcnCallFac(), qso->getDerefFactory(),
                    qso->getRefFactory(), ops->getControlFlow(), ops->getBase(), ops->getBit(),
                    &database, &srcRefServer, slices, &contexts, ops->getLoop(), &evaluator,
                    &options, &variables, c->getRangeServer());
    }

    // ---- Types, scalings, symbols, operands ----------------------------------------------
    // "sint16", "sint16*" for a pointer, "sint16[4]" for a vector.
    KS_DataType* type(const std::string& name) {
        KS_DataType* found = nullptr;
        bool ok = false;
        if (name.ends_with("*"))
            ok = types.getPointerType(name.substr(0, name.size() - 1).c_str(), position, &found);
        else if (auto open = name.find('['); open != std::string::npos)
            ok = types.getVectorType(name.substr(0, open).c_str(), std::stoi(name.substr(open + 1)),
                                     position, &found);
        else
            ok = types.getDataType(name.c_str(), position, &found);
        EXPECT_TRUE(ok) << name;
        return found;
    }
    KS_Scaling* lsb(double value, double offset = 0) {
        return model.getScaleServer()->getScaling(value, offset, nullptr);
    }
    KS_Scaling* defaultScaling() { return model.getScaleServer()->getDefaultScaling(); }
    KS_Scaling* boolScaling() { return model.getScaleServer()->getDefaultBoolScaling(); }
    KS_BaseTypeServer& base() { return *model.getBaseTypeServer(); }

    KsCVarClassId* varClass(const char* name) {
        return model.getVarClassServer()->demandVariableClass(name, nullptr, nullptr);
    }
    KsCUnparamSymbol* variable(const std::string& name, const std::string& typeName,
                               KS_Scaling* scaling = nullptr) {
        return model.variableSymbols().create(name.c_str(), 0, type(typeName),
                                              scaling ? scaling : defaultScaling(),
                                              varClass("GlobalVar"), nullptr);
    }
    KS_ExprLocation* access(KsCUnparamSymbol* symbol) {
        KS_ExprLocation* location = nullptr;
        EXPECT_TRUE(icf.createVariableLocation(symbol, position, location));
        return location;
    }
    // An access to a fresh variable of that type and scaling.
    KS_ExprLocation* operand(const std::string& typeName, KS_Scaling* scaling = nullptr) {
        return access(variable("v" + std::to_string(++operands_), typeName, scaling));
    }
    KS_ExprLocation* constant(double value) {
        KS_ExprLocation* location = nullptr;
        EXPECT_TRUE(icf.createConstantLocation(value, position, location));
        return location;
    }

    // A function (or, with `macro`, a parameterised macro) of the file "t" returning sint16.
    KsCParamSymbol* function(const char* name, const char* fcnClass,
                             const std::vector<Parameter>& parameters, bool macro = false) {
        KS_SymbolServer* symbols = model.getSymbolServer();
        KsCFcnClassId* klass = model.getSmbClassServer()->getFcnClassServer()->demandFunctionClass(
            fcnClass, nullptr, nullptr);
        KsCParamSymbol* made =
            macro ? symbols->getParamMacro()->createParamMacroAndDepStt(
                        name, 0, type("sint16"), defaultScaling(), klass, file, nullptr)
                  : symbols->getFunction()->createFunctionAndDepStt(
                        file, name, 0, type("sint16"), defaultScaling(), klass, nullptr);
        for (const Parameter& p : parameters) {
            KsCUnparamSymbol* parameter = symbols->getFunction()->createParamSymbol(
                p.name, 0, type(p.type), lsb(0.25), varClass(p.varClass), nullptr);
            EXPECT_TRUE(macro ? symbols->getParamMacro()->addToParameterList(made, parameter)
                              : symbols->getFunction()->addToParameterList(made, parameter));
        }
        return made;
    }

    // ---- Annotations parsed from text -----------------------------------------------------
    template <class Node> Node* annotation(const std::string& text) {
        const std::size_t before = nodes<Node>().size();
        EXPECT_NE(parse(text), nullptr) << text;
        auto all = nodes<Node>();
        return all.size() > before ? all[before] : nullptr;
    }
    KsCItfAdditionalInfo_OpInfo* opInfo(const std::string& properties) {
        return annotation<KsCItfAdditionalInfo_OpInfo>("void f() { r = a ADD(" + properties +
                                                       ") b; }");
    }
    KsCItfAdditionalInfo_ArgInfo* argInfo(const std::string& properties) {
        return annotation<KsCItfAdditionalInfo_ArgInfo>("void f() { g(ARG_INFO(" + properties +
                                                        ") b); }");
    }
    KsCItfAdditionalInfo_IdxInfo* idxInfo(const std::string& properties) {
        return annotation<KsCItfAdditionalInfo_IdxInfo>("void f() { r = p[IDX_INFO(" + properties +
                                                        ") 2]; }");
    }
    KsCItfAdditionalInfo_IcInfo* icInfo(const std::string& properties) {
        return annotation<KsCItfAdditionalInfo_IcInfo>("void f() { r = p[IC_INFO(" + properties +
                                                       ")]; }");
    }
    KsCItfAdditionalInfo_LoopInfo* loopInfo(const std::string& properties) {
        return annotation<KsCItfAdditionalInfo_LoopInfo>("void f() { while (i < n; LOOP_INFO(" +
                                                         properties + ")) i++; }");
    }

    // ---- Reading back ---------------------------------------------------------------------
    static const KsCHostExprLocation* host(const KS_ExprLocation* location) {
        return KsCHostExprLocation::of(location);
    }
    static const KsCHostOperationData* operation(const KS_ExprLocation* location) {
        const KsCHostExprLocation* found = KsCHostExprLocation::of(location);
        return found ? found->hostOperation() : nullptr;
    }
    static std::string name(const KS_DataType* type) {
        return type ? type->getName().str() : "(none)";
    }
    std::size_t operationCount() const { return model.icode().operations().size(); }
    // The error text the factory reports for `what` at the test's position.
    static std::string traversal(const std::string& what) {
        return "ICode test frame error: Error traversing syntax tree in file t, line 7, column "
               "3: " +
               what;
    }
    static std::string warning(const std::string& what) {
        return "ICode test frame warning: File t, line 7, column 3: " + what;
    }

    KsCHostCodeModel model;
    KsCHostOptions options;
    KsCItfSymbolClassServer classes;
    KsCItfDataTypeServer types;
    KsCItfAdditionalInfoEvaluator evaluator;
    KsCItfExprLocationDB database;
    KsCItfVariableServer variables;
    KsCItfIterationContextServer contexts;
    KsCItfICodeFactory icf;
    KsCItfSrcRef* position = nullptr;
    KsCIcFileId* file = nullptr;

private:
    int operands_ = 0;
};
