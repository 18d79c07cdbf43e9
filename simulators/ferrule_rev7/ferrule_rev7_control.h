// Control interface of the simulated phase reference driver libFerrule_rev7.so.
//
// The simulator exports the driver's nine entry points with the driver's behaviour (0 for
// success, a device error code otherwise) and, beside them, these functions, through which a
// test or a bench setup chooses what the simulated devices are and which calls fail. Reach
// them with dlsym on the loaded library; the function types below name their signatures.
//
// Without any control call the simulator shows one device, model "Ferrule rev7 (simulated)",
// serial number "FR7-SIM-0001", and every call succeeds. Error codes the simulator gives of
// its own accord: 1 device number out of range, 3 wrong access string, 4 divide ratio set on
// a device not started.
// Thread-safety: none; drive the simulator from one thread.
#pragma once

#ifdef __cplusplus
extern "C" {
#endif

/// Most devices the simulator can show.
#define FERRULE_SIM_MAX_DEVICES 16

/// Back to the start-up state: one device, default texts, no failures, no calls counted,
/// nothing started.
void ferruleSimReset(void);
/// Number of connected devices, 0 to FERRULE_SIM_MAX_DEVICES (clamped).
void ferruleSimSetDeviceCount(int count);
/// Model text of `device` (0-based); texts of 1000 bytes or more fill the driver's buffer
/// completely, with no terminating zero, as a careless driver would. Returns 0, or -1 for a
/// device number out of range or a null text.
int ferruleSimSetModel(int device, const char* text);
/// Serial number of `device`, as ferruleSimSetModel.
int ferruleSimSetSerialNumber(int device, const char* text);
/// Makes every later call of the export `exportName` ("startHalcyon", "makeRatio4", ...)
/// return `code` (for "getNumConnectedDevice": the count it returns); 0 clears the failure
/// (for the count: the configured count is returned again). Returns 0, or -1 for a name that
/// is not one of the nine exports.
int ferruleSimSetFailure(const char* exportName, int code);
/// How often `exportName` was called since the last reset; -1 for an unknown name.
int ferruleSimCallCount(const char* exportName);
/// The divide ratio last set on `device` (1 to 16), 0 when none was set or out of range.
int ferruleSimDivideRatio(int device);
/// The access string of the last startHalcyon call ("" before any).
const char* ferruleSimLastAccess(void);

typedef void (*FerruleSimResetFunc)(void);
typedef void (*FerruleSimSetDeviceCountFunc)(int);
typedef int (*FerruleSimSetTextFunc)(int, const char*);
typedef int (*FerruleSimSetFailureFunc)(const char*, int);
typedef int (*FerruleSimCallCountFunc)(const char*);
typedef int (*FerruleSimDivideRatioFunc)(int);
typedef const char* (*FerruleSimLastAccessFunc)(void);

#ifdef __cplusplus
}
#endif
