#include "MethodRegistration.h"

#include "JsonRpcManager.h"
#include "ProviderDiscoveryMethods.h"

namespace OLMA
{

void MethodRegistration::registerMethods()
{
    ProviderDiscoveryMethods::registerMethods(*JsonRpcManager::instance());
}

} // namespace OLMA
