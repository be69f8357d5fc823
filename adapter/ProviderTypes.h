#ifndef _VSPR_ProviderTypes_h
#define _VSPR_ProviderTypes_h

// Ids shared by the facades, the helpers and diagnostics. The values are
// indexes into the name tables of ProviderUtil, so they must not move.

namespace OLMA
{

// One id per class of the model. An id names the class that a provider asks
// a facade for; each enumerator is ID_ followed by the class name.
enum classId_t
{
    ID_NONE = 0,
    ID_VESPERA_ComputerSystem = 1,
    ID_VESPERA_PortController = 2,
    ID_VESPERA_FCPort = 3,
    ID_VESPERA_SCSIProtocolEndpoint = 4,
    ID_VESPERA_FCPortStatistics = 5,
    ID_VESPERA_PhysicalPackage = 6,
    ID_VESPERA_Product = 7,
    ID_VESPERA_AdapterSoftwareIdentity = 8,
    ID_VESPERA_StorageExtent = 9,
    ID_VESPERA_RegisteredProfile = 10,
    ID_VESPERA_RegisteredSubProfile = 11,
    ID_VESPERA_Namespace = 12,
    ID_VESPERA_ObjectManager = 13,
    ID_VESPERA_CIMXMLCommunicationMechanism = 14,
    ID_VESPERA_ProfileSoftwareIdentity = 15,
    ID_VESPERA_TapeDrive = 16,
    ID_VESPERA_RemoteServiceAccessPoint = 17,
    ID_VESPERA_HBASoftwareInstallationService = 18,
    ID_VESPERA_HBASoftwareInstallationServiceCapabilities = 19,
    ID_VESPERA_EthernetPort = 20,
    ID_VESPERA_MemoryDiagnosticTest = 21,
    ID_VESPERA_LoopbackDiagnosticTest = 22,
    ID_VESPERA_PCILoopbackDiagnosticTest = 23,
    ID_VESPERA_EthLoopbackDiagnosticTest = 24,
    ID_VESPERA_DiagnosticSoftwareIdentity = 25,
    ID_VESPERA_ConcreteJob = 26,
    ID_VESPERA_DiagnosticServiceRecord = 27,
    ID_VESPERA_DiagnosticCompletionRecord = 28,
    ID_VESPERA_DiagnosticElementSoftwareIdentity = 29,
    ID_VESPERA_LogicalPortGroup = 30,
    ID_VESPERA_AffectedJobElement = 31,
    ID_VESPERA_ServiceRecordAppliesToElement = 32,
    ID_VESPERA_CompletionRecordAppliesToElement = 33,
    ID_VESPERA_LANEndpoint = 34,
    ID_VESPERA_PhysicalConnector = 35,
    ID_VESPERA_AlarmDevice = 36,
    ID_VESPERA_AgentService = 37,
    ID_VESPERA_LogicalDisk = 38,
    MAXCLASSID = 38
};

// The diagnostic tests; DIAG_NAME_INVALID is the first value past the table.
enum diag_test_id_t
{
    DIAG_NONE = 0,
    DIAG_MEMORY_TEST = 1,
    DIAG_INTERNAL_LOOPBACK_TEST = 2,
    DIAG_EXTERNAL_LOOPBACK_TEST = 3,
    DIAG_SERDES_LOOPBACK_TEST = 4,
    DIAG_PCI_LOOPBACK_TEST = 5,
    DIAG_EXTERNAL_ETH_LOOPBACK_TEST = 6,
    DIAG_SERDES_ETH_LOOPBACK_TEST = 7,
    DIAG_NAME_INVALID = 8
};

// The fixed texts of diagnostic records, in the order of diagRecordMsgArray.
enum diag_record_msg_t
{
    REC_NONE = 0,
    REC_MEM_CHECK_ADAPTER_DISABLED = 1,
    REC_ADAPTER_NOT_DISABLED = 2,
    REC_MEM_DISABLING_ADAPTER = 3,
    REC_MEM_ENABLING_ADAPTER = 4,
    REC_MEM_RUNNING = 5,
    REC_MEM_CHECKING_RC = 6,
    REC_MEM_SUCCESS = 7,
    REC_MEM_FAILED = 8,
    REC_PCI_RUNNING = 9,
    REC_PCI_CHECKING_RC = 10,
    REC_PCI_SUCCESS = 11,
    REC_PCI_FAILED = 12,
    REC_LB_CHECK_PORT_DISABLED = 13,
    REC_PORT_ALREADY_DISABLED = 14,
    REC_PORT_NOT_DISABLED = 15,
    REC_LB_DISABLING_PORT = 16,
    REC_LB_ENABLING_PORT = 17,
    REC_LB_RUNNING = 18,
    REC_LB_CHECKING_RC = 19,
    REC_LB_SUCCESS = 20,
    REC_LB_FAILED = 21,
    REC_ETH_CHECK_PORT_DISABLED = 22,
    REC_ETH_DISABLING_PORT = 23,
    REC_ETH_ENABLING_PORT = 24,
    REC_ETH_RUNNING = 25,
    REC_ETH_CHECKING_RC = 26,
    REC_ETH_SUCCESS = 27,
    REC_ETH_FAILED = 28,
    REC_DISABLING_PORT = 29,
    REC_ENABLING_PORT = 30,
    REC_DISABLE_PORT_FAILED = 31,
    REC_MEM_MAY_TAKE_MOMENTS = 32,
    REC_ADAPTER_ALREADY_DISABLED = 33,
    REC_ETH_ABORTED = 34,
    REC_UNKNOWN_FAILURE = 35,
    REC_MAX_ID = 36
};

// Name tables, indexed by the enumerators above; row 0 is "--".
extern const char* const classNames[MAXCLASSID + 1];
extern const char* const diagTestNames[DIAG_NAME_INVALID];
extern const char* const diagRecordMsgArray[REC_MAX_ID];

} // namespace OLMA

#endif
