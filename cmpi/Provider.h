#ifndef _OLMA_Provider_h
#define _OLMA_Provider_h

// Everything a provider class needs: instances, its status enums and the
// handlers it sends instances to. A provider is a plain class with no common
// base that declares only what it implements; its dispatch function calls
// those members by name and answers for the others.

#include "Instance.h"
#include "Provider_Status.h"
#include "Provider_Handler.h"

#endif // _OLMA_Provider_h
