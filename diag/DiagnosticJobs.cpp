// The job of the latest run and the two record lists.
#include "DiagnosticHelper.h"

#include <stdio.h>
#include <string.h>

#include "ProviderUtil.h"
#include "log.h"

#include "CIM_LogicalDevice.h"
#include "VESPERA_AffectedJobElement.h"
#include "VESPERA_ConcreteJob.h"

namespace OLMA
{

uint32 DiagnosticHelper::getNextJobID()
{
    return ++nextJobId;
}

uint32 DiagnosticHelper::getNextRecordID()
{
    return ++nextRecordId;
}

DiagnosticJob DiagnosticHelper::createDiagnosticJob(DiagnosticTestInput* input)
{
    DiagnosticJob job;

    // The number has seven characters at most.
    char number[8];
    snprintf(number, sizeof(number), "%d", (int)getNextJobID());

    job.name = ProviderUtil::getProviderUtil()->getDiagTestName(input->testId);
    job.name.append("-");
    job.name.append(number);
    job.elementClass = input->elementClass;
    job.jobState = DIAG_JOB_RUNNING;
    job.startTime = Datetime::now();
    job.elapsedTime = Datetime((uint64)0);
    job.percentComplete = 0;
    job.adapterAddress = input->adapterAddress;
    job.portWwn = input->portWwn;
    job.portMac = input->portMac;

    VESPERA_ConcreteJob* ref = create<VESPERA_ConcreteJob>(true);
    ref->InstanceID.set(job.name);
    job.jobRef.reset(ref);
    return job;
}

void DiagnosticHelper::addDiagnosticJob(DiagnosticJob job)
{
    Auto_Mutex hold(jobLock);
    jobs.clear();
    jobs.push_back(job);
}

bool DiagnosticHelper::isAnyJobRunning()
{
    Auto_Mutex hold(jobLock);

    for (const DiagnosticJob& job : jobs)
    {
        if (job.jobState == DIAG_JOB_RUNNING)
            return true;
    }

    return false;
}

void DiagnosticHelper::updateJobState(String jobId)
{
    Auto_Mutex hold(jobLock);

    for (DiagnosticJob& job : jobs)
    {
        if (job.name.equali(jobId))
        {
            job.jobState = DIAG_JOB_COMPLETED;
            job.percentComplete = 100;
            return;
        }
    }
}

bool DiagnosticHelper::getLatestJob(DiagnosticJob& job)
{
    Auto_Mutex hold(jobLock);

    if (jobs.empty())
        return false;

    job = jobs.back();
    return true;
}

Instance* DiagnosticHelper::getConcreteJobInstance(DiagnosticJob job)
{
    VESPERA_ConcreteJob* instance = create<VESPERA_ConcreteJob>(true);

    instance->InstanceID.set(job.name);
    instance->Name.set(job.name);
    instance->JobState.set(job.jobState);
    instance->StartTime.set(job.startTime);
    instance->ElapsedTime.set(job.elapsedTime);
    instance->PercentComplete.set(job.percentComplete);
    return instance;
}

Array<Instance*> DiagnosticHelper::getDiagnosticJobInstances()
{
    Auto_Mutex hold(jobLock);
    Array<Instance*> result;

    for (const DiagnosticJob& job : jobs)
        result.append(getConcreteJobInstance(job));

    return result;
}

Array<Instance*> DiagnosticHelper::getDiagnosticAffectedJobElementInstances()
{
    // The elements are fetched from the library after the lock is gone.
    std::vector<DiagnosticJob> copies;
    {
        Auto_Mutex hold(jobLock);
        copies = jobs;
    }

    Array<Instance*> result;

    for (const DiagnosticJob& job : copies)
    {
        DiagnosticRecord named;
        named.elementClass = job.elementClass;
        named.adapterAddress = job.adapterAddress;
        named.portWwn = job.portWwn;
        named.portMac = job.portMac;

        VESPERA_AffectedJobElement* a = create<VESPERA_AffectedJobElement>(true);
        a->AffectedElement = (CIM_ManagedElement*)getManagedElementInstance(named);
        a->AffectingElement = (CIM_Job*)getConcreteJobInstance(job);
        result.append(a);
    }

    return result;
}

String DiagnosticHelper::getInstanceIDForRecord(String jobId)
{
    char id[50];
    memset(id, 0, sizeof(id));
    snprintf(id, sizeof(id), "%s:%d", jobId.c_str(), (int)getNextRecordID());
    return String(id);
}

void DiagnosticHelper::generateDiagnosticRecord(String text, bool isServiceRecord,
    DiagnosticTestInput* input, diag_compl_record_state_t state)
{
    DiagnosticRecord record;

    record.isServiceRecord = isServiceRecord;
    record.instanceId = getInstanceIDForRecord(input->jobId);
    record.timeStamp = Datetime::now();
    record.recordData = text;
    record.serviceName = ProviderUtil::getProviderUtil()->getDiagTestName(input->testId);
    record.recordType = isServiceRecord ? 4 : 6;

    if (!isServiceRecord)
        record.completionState = state;

    record.elementClass = input->elementClass;
    record.adapterAddress = input->adapterAddress;
    record.portWwn = input->portWwn;
    record.portMac = input->portMac;

    getDiagnosticHelperObject()->addDiagnosticRecord(record);
}

void DiagnosticHelper::addDiagnosticRecord(DiagnosticRecord record)
{
    std::vector<DiagnosticRecord>& list = record.isServiceRecord ?
        serviceRecords : completionRecords;
    Auto_Mutex hold(record.isServiceRecord ? serviceRecordLock : completionRecordLock);

    list.push_back(record);

    if (list.size() > DIAG_MAX_RECORDS)
        list.erase(list.begin(), list.begin() + (list.size() - DIAG_MAX_RECORDS));
}

} // namespace OLMA
