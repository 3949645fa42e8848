// A daily task for the installed program, made by a worker through the system's task scheduler.
#include <windows.h>
// after windows.h
#include <mstask.h>

#include <cstdlib>
#include <cstring>

#include "foundation/os/OsWide.h"
#include "installer/CNInstallWizard.h"
#include "installer/ComPointer.h"
#include "installer/CommandTools.h"

// The scheduler's identifiers under names of their own: the import library's unit with all of the system's is large.
static const GUID SCHEDULER_CLASS = {0x148BD52A, 0xA2AB, 0x11CE, {0xB1, 0x1F, 0x00, 0xAA, 0x00, 0x53, 0x05, 0x03}};
static const GUID TASK_CLASS = {0x148BD520, 0xA2AB, 0x11CE, {0xB1, 0x1F, 0x00, 0xAA, 0x00, 0x53, 0x05, 0x03}};
static const GUID SCHEDULER_INTERFACE = {0x148BD527, 0xA2AB, 0x11CE, {0xB1, 0x1F, 0x00, 0xAA, 0x00, 0x53, 0x05, 0x03}};
static const GUID TASK_INTERFACE = {0x148BD524, 0xA2AB, 0x11CE, {0xB1, 0x1F, 0x00, 0xAA, 0x00, 0x53, 0x05, 0x03}};

static HRESULT SetDaily(ITask* pTask, const ScheduledTask& task) {
  ComPointer<ITaskTrigger> pTrigger;
  WORD wTrigger = 0;
  SYSTEMTIME now;
  const HRESULT hres = pTask->CreateTrigger(&wTrigger, reinterpret_cast<ITaskTrigger**>(pTrigger.Receive()));
  if (FAILED(hres)) return hres;
  GetLocalTime(&now);
  TASK_TRIGGER trigger = {};
  trigger.cbTriggerSize = sizeof(trigger);
  trigger.wBeginYear = now.wYear;
  trigger.wBeginMonth = now.wMonth;
  trigger.wBeginDay = now.wDay;
  trigger.wStartHour = static_cast<WORD>(task.iHour);
  trigger.wStartMinute = static_cast<WORD>(task.iMinute);
  trigger.TriggerType = TASK_TIME_TRIGGER_DAILY;
  trigger.Type.Daily.DaysInterval = 1;
  return pTrigger->SetTrigger(&trigger);
}

// The account's password is not known: the task runs while the user is logged on, who then needs none.
static HRESULT FillTask(ITask* pTask, const ScheduledTask& task) {
  wchar_t szUser[257] = L"";
  DWORD dwSize = 257;
  GetUserNameW(szUser, &dwSize);
  const HRESULT results[] = {
      pTask->SetApplicationName(Wide(task.csProgram.Text())),
      pTask->SetWorkingDirectory(Wide(task.csFolder.Text())),
      pTask->SetParameters(Wide(task.csArguments.Text())),
      SetDaily(pTask, task),
  };
  for (const HRESULT hres : results)
    if (FAILED(hres)) return hres;
  pTask->SetFlags(TASK_FLAG_RUN_ONLY_IF_LOGGED_ON);
  pTask->SetAccountInformation(szUser, nullptr);
  return S_OK;
}

static HRESULT MakeTask(const ScheduledTask& task) {
  const ComApartment apartment;
  ComPointer<ITaskScheduler> pScheduler;
  ComPointer<ITask> pTask;
  ComPointer<IPersistFile> pFile;
  HRESULT hres =
      CoCreateInstance(SCHEDULER_CLASS, nullptr, CLSCTX_INPROC_SERVER, SCHEDULER_INTERFACE, pScheduler.Receive());
  if (FAILED(hres)) return hres;
  pScheduler->Delete(Wide(task.csName.Text()));  // of an earlier installation
  hres = pScheduler->NewWorkItem(Wide(task.csName.Text()), TASK_CLASS, TASK_INTERFACE,
                                 reinterpret_cast<IUnknown**>(pTask.Receive()));
  if (SUCCEEDED(hres)) hres = FillTask(pTask.operator->(), task);
  if (SUCCEEDED(hres)) hres = pTask->QueryInterface(IID_IPersistFile, pFile.Receive());
  return SUCCEEDED(hres) ? pFile->Save(nullptr, TRUE) : hres;
}

void CNInstallWizard::AddTaskWork() {
  const HRESULT hres = MakeTask(m_Task);
  m_bAddingTask = 0;
  if (FAILED(hres)) LogPrintf("ERROR: CNInstallWizard::AddTaskWork -> MakeTask -> 0x%x", static_cast<unsigned>(hres));
  PostWorkDone();
}

int CNInstallWizard::iAddScheduledTask(const char* /*szParam*/, int* pCommandResult) {
  while (m_bAddingTask) OsSleep(5);  // that of a task before this one
  const TextList time(szOr(szValue("task_time"), "12:00"), ":");
  m_Task.csName = szOr(szValue("task_name"), szValue("program_name"));
  GetDestination(m_Task.csFolder);
  m_Task.csProgram = Joined(m_Task.csFolder.Text(), "\\", szOr(szValue("task_program"), szValue("program_file")));
  m_Task.csArguments = szValue("task_arguments");
  m_Task.iHour = time.Size() == 2 ? atoi(time[0]) : -1;
  m_Task.iMinute = time.Size() == 2 ? atoi(time[1]) : -1;
  const bool bTime = m_Task.iHour >= 0 && m_Task.iHour < 24 && m_Task.iMinute >= 0 && m_Task.iMinute < 60;
  if (m_Task.csName.bEmpty() || strpbrk(m_Task.csName.Text(), "\\/:;") || m_Task.csFolder.bEmpty() || !bTime)
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iAddScheduledTask -> !task_name || !task_time -> return FUNCTION_ERROR");
  AddUndo("scheduled_task", m_Task.csName.Text());
  m_bAddingTask = 1;
  if (!bStartTask(&CNInstallWizard::AddTaskWork))
    return m_bAddingTask = 0,
           iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iAddScheduledTask -> !bStartTask -> return FUNCTION_ERROR");
  return iAnswer(pCommandResult, COMMAND_DONE);
}
