"""Methods that the module's CIM_ classes carry beyond the 2.26 Final files.

The Final MOF of CIM 2.26 leaves out the elements that were still
experimental in that release. The module's classes were built from the
experimental flavour of 2.26, so a few methods that providers answer (if
only with "unsupported"), and the port availability of an FC port, are
missing from the Final files. They are declared here, methods with their
parameters in the schema's order, and inserted into the named class behind
the named feature (None: at the end).

A CIM server that holds only 2.26 Final knows none of them, and refuses a
property that its class doesn't declare; so schema/mof/vespera.mof declares
each of them again in the VESPERA_ classes that inherit it, without
Override. The generator checks that such a declaration says what the
addition says.
"""

ADDITIONS = [
    ('CIM_FCPort', None, '''
        [Experimental]
        uint16 PortAvailability = 2;
    '''),
    ('CIM_Service', None, '''
        [Experimental]
        uint32 ChangeAffectedElementsAssignedSequence(
            [In, Required] CIM_ManagedElement REF ManagedElements[],
            [In, Required] uint16 AssignedSequence[],
            [In(false), Out] CIM_ConcreteJob REF Job);
    '''),
    ('CIM_ProtocolEndpoint', None, '''
        [Experimental]
        uint32 BroadcastReset();
    '''),
    ('CIM_ConcreteJob', 'GetError', '''
        [Experimental]
        uint32 GetErrors(
            [In(false), Out, EmbeddedInstance("CIM_Error")] string Errors[]);
    '''),
    ('CIM_SoftwareInstallationService', 'InstallFromSoftwareIdentity', '''
        [Experimental]
        uint32 InstallFromByteStream(
            [In(false), Out] CIM_ConcreteJob REF Job,
            [In, OctetString] uint8 Image[],
            [In] CIM_ManagedElement REF Target,
            [In] uint16 InstallOptions[],
            [In] string InstallOptionsValues[]);
    '''),
    ('CIM_Capabilities', None, '''
        [Experimental]
        uint16 CreateGoalSettings(
            [In, EmbeddedInstance("CIM_SettingData")] string TemplateGoalSettings[],
            [In, Out, EmbeddedInstance("CIM_SettingData")] string SupportedGoalSettings[]);
    '''),
    ('CIM_RegisteredProfile', None, '''
        [Experimental]
        uint32 CloseConformantInstances(
            [In, Required] string EnumerationContext);
    '''),
    ('CIM_RegisteredProfile', None, '''
        [Experimental]
        uint32 OpenConformantInstances(
            [In] string ResultClass,
            [In] string IncludedPropertyList[],
            [In] uint32 OperationTimeout,
            [In] boolean ContinueOnError,
            [In] uint32 MaxObjectCount,
            [In(false), Out] string EnumerationContext,
            [In(false), Out] boolean EndOfSequence,
            [In(false), Out] uint16 InstanceType[],
            [In(false), Out, EmbeddedObject] string InstanceWithPathList[]);
    '''),
    ('CIM_RegisteredProfile', None, '''
        [Experimental]
        uint32 PullConformantInstances(
            [In, Out, Required] string EnumerationContext,
            [In] uint32 MaxObjectCount,
            [In(false), Out] boolean EndOfSequence,
            [In(false), Out] uint16 InstanceType[],
            [In(false), Out, EmbeddedObject] string InstanceWithPathList[]);
    '''),
]
