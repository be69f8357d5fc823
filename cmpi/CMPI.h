#ifndef _OLMA_CMPI_h
#define _OLMA_CMPI_h

// The CMPI declarations: ours, or a CIM server's own (VSPR_CMPI_INCLUDE_DIR).
// Only what both offer is used: no 2.0 slot, and calls of slots whose macro
// a 1.0 build of some servers' headers lacks go through the tables.

#include <cmpidt.h>
#include <cmpift.h>
#include <cmpimacs.h>

#endif // _OLMA_CMPI_h
