#include "ItfICodeFactory/KsCVSQSOFactoryInterface.h"

KsCVSQSOFactoryInterface::KsCVSQSOFactoryInterface() = default;
KsCVSQSOFactoryInterface::KsCVSQSOFactoryInterface(const KsCVSQSOFactoryInterface&) = default;
KsCVSQSOFactoryInterface&
KsCVSQSOFactoryInterface::operator=(const KsCVSQSOFactoryInterface&) = default;
KsCVSQSOFactoryInterface::~KsCVSQSOFactoryInterface() = default;
