#include "diagnostics/etw_catalogue.h"

#include <algorithm>

#include "lumen/diagnostics/event_tracing.h"

namespace LumenUtility {
namespace {

// Keyword groups.
constexpr std::uint64_t kNoGroup = 0x0;
constexpr std::uint64_t kMeasurement = 0x1;
constexpr std::uint64_t kHardware = 0x2;
constexpr std::uint64_t kSweep = 0x4;
constexpr std::uint64_t kCalibration = 0x8;
constexpr std::uint64_t kDisplay = 0x10;
constexpr std::uint64_t kRemote = 0x20;

using K = ETWLoggerKind;

// A task: its start event (opcode 10) and stop event (opcode 11), or a single event
// (opcode 0) when stopId is 0. Event names are the task's with "Start" and "Stop".
struct TaskDefinition {
  std::uint16_t task;
  const char* name;
  std::uint16_t startId;
  K startKind;
  std::uint16_t stopId;
  K stopKind;
  std::uint64_t group;
  std::uint8_t version;
};

constexpr TaskDefinition kTasks[] = {
    {1, "Sweep", 1, K::None, 2, K::None, kMeasurement | kSweep, 1},
    {2, "ChannelSweep", 3, K::Int, 4, K::Int, kMeasurement | kSweep, 1},
    {3, "TriggerWait", 5, K::Int, 6, K::Int, kHardware, 1},
    {4, "DataProcessing", 7, K::None, 8, K::Int, kMeasurement, 1},
    {5, "MeasurementUpdate", 10, K::Int, 11, K::Int, kMeasurement, 1},
    {6, "DisplayUpdate", 12, K::None, 13, K::None, kDisplay, 1},
    {7, "HardwareSetup", 14, K::Int, 15, K::Int, kHardware, 1},
    {8, "SourceSettle", 16, K::Int, 17, K::Int, kHardware, 1},
    {9, "ReceiverRead", 18, K::Int, 19, K::Int, kHardware, 1},
    {10, "RemoteCommand", 20, K::IntString, 21, K::IntString, kRemote, 1},
    {11, "RemoteQuery", 22, K::IntString, 23, K::IntString, kRemote | kMeasurement, 1},
    {12, "Correction", 24, K::None, 25, K::None, kCalibration, 1},
    {13, "CalStandardMeasure", 26, K::Int, 27, K::Int, kCalibration, 1},
    {14, "CalCompute", 28, K::Int, 29, K::Int, kCalibration, 1},
    {15, "CalSetLoad", 30, K::String, 31, K::String, kCalibration, 1},
    {16, "CalSetSave", 32, K::String, 33, K::String, kCalibration, 1},
    {17, "Averaging", 34, K::Int, 35, K::Int, kMeasurement, 1},
    {18, "PhaseStitch", 36, K::Int, 37, K::Int, kMeasurement, 1},
    {19, "FileLoad", 38, K::String, 39, K::String, kNoGroup, 1},
    {20, "FifoWrite", 40, K::Int, 41, K::Int, kMeasurement, 1},
    {21, "DataCapture", 43, K::Int, 44, K::Int, kMeasurement, 1},
    {22, "Interpolation", 45, K::Int, 46, K::Int, kMeasurement, 1},
    {23, "ArchiveWrite", 47, K::Int, 48, K::String, kNoGroup, 1},
    {24, "MarkerSearch", 49, K::Int, 50, K::Int, kDisplay, 1},
    {25, "LimitTest", 51, K::Int, 52, K::Int, kMeasurement, 1},
    {26, "ErrorReported", 53, K::Int, 0, K::None, kNoGroup, 0},
    {27, "MacroRun", 55, K::String, 56, K::String, kRemote, 1},
    {28, "StateRecall", 57, K::String, 58, K::String, kNoGroup, 1},
    {29, "StateSave", 59, K::String, 60, K::String, kNoGroup, 1},
    {30, "PowerCal", 61, K::Int, 62, K::Int, kCalibration, 1},
    {31, "MessageSend", 63, K::String, 64, K::String, kRemote, 1},
    {32, "SingleTrigger", 65, K::None, 66, K::None, kMeasurement | kSweep, 1},
    {33, "Hold", 67, K::None, 68, K::None, kMeasurement | kSweep, 1},
    {34, "Preset", 69, K::None, 70, K::None, kNoGroup, 1},
    {35, "RenderTraces", 71, K::None, 72, K::None, kDisplay, 1},
    {36, "RenderMarkers", 73, K::None, 74, K::None, kDisplay, 1},
    {37, "RenderAnnotation", 75, K::None, 76, K::None, kDisplay, 1},
    {38, "SourceLevelCheck", 77, K::None, 78, K::None, kHardware, 1},
    {39, "TimeDomainTransform", 79, K::None, 80, K::None, kMeasurement, 1},
    {40, "EquationEvaluate", 81, K::None, 82, K::None, kMeasurement, 1},
    {41, "RemoteQueueFlush", 83, K::None, 84, K::None, kRemote, 1},
    {42, "CalInterpolation", 85, K::None, 86, K::None, kCalibration, 1},
    {43, "PortExtension", 87, K::Int, 88, K::Int, kCalibration, 1},
    {44, "ExternalDeviceSync", 89, K::None, 90, K::None, kHardware, 0},
    {45, "GlobalStateApply", 91, K::None, 92, K::None, kNoGroup, 0},
    {46, "PathConfiguration", 93, K::Int, 94, K::Int, kHardware, 1},
    {47, "FrequencyReferenceChange", 95, K::Int, 96, K::Int, kHardware, 1},
    {48, "MessageReceive", 97, K::Int, 98, K::Int, kRemote, 1},
};

ETWEventDefinition Event(const TaskDefinition& task, std::uint16_t id, K kind,
                         std::uint8_t opcode, const char* suffix) {
  const EVENT_DESCRIPTOR descriptor{id,     task.version, kETWChannel,
                                    kETWLevel, opcode,    task.task,
                                    kETWChannelKeyword | task.group};
  return ETWEventDefinition{descriptor, kind, std::string(task.name) + suffix, task.name};
}

std::vector<ETWEventDefinition> BuildCatalogue() {
  std::vector<ETWEventDefinition> events;
  for (const TaskDefinition& task : kTasks) {
    if (task.stopId == 0) {
      events.push_back(Event(task, task.startId, task.startKind, kETWOpcodeInfo, ""));
      continue;
    }
    events.push_back(Event(task, task.startId, task.startKind, kETWOpcodeStart, "Start"));
    events.push_back(Event(task, task.stopId, task.stopKind, kETWOpcodeStop, "Stop"));
  }
  std::sort(events.begin(), events.end(), [](const auto& a, const auto& b) {
    return a.descriptor.Id < b.descriptor.Id;
  });
  return events;
}

std::vector<TraceField> Fields(ETWLoggerKind kind) {
  const TraceField value{"value", TraceFieldType::Int32};
  const TraceField text{"text", TraceFieldType::Utf16String};
  switch (kind) {
    case K::None: return {};
    case K::Int: return {value};
    case K::String: return {text};
    case K::IntString: return {value, text};
  }
  return {};
}

TracePhase Phase(std::uint8_t opcode) {
  return opcode == kETWOpcodeStart ? TracePhase::Begin
         : opcode == kETWOpcodeStop ? TracePhase::End
                                    : TracePhase::Instant;
}

TraceManifest BuildManifest() {
  std::vector<TraceEventInfo> events;
  for (const ETWEventDefinition& event : ETWCatalogue()) {
    events.push_back(TraceEventInfo{event.descriptor.Id, event.name, event.task,
                                    Phase(event.descriptor.Opcode), Fields(event.kind)});
  }
  return TraceManifest("LumenUtility", ETWProviderId(), std::move(events),
                       {{kMeasurement, "Measurement"},
                        {kHardware, "Hardware"},
                        {kSweep, "Sweep"},
                        {kCalibration, "Calibration"},
                        {kDisplay, "Display"},
                        {kRemote, "Remote"}});
}

}  // namespace

const std::vector<ETWEventDefinition>& ETWCatalogue() {
  static const std::vector<ETWEventDefinition> catalogue = BuildCatalogue();
  return catalogue;
}

const GUID& ETWProviderId() {
  static constexpr GUID id = {
      0x532E117B, 0xE9BD, 0x4FE9, {0xB3, 0xBA, 0xB0, 0x09, 0x37, 0x5F, 0x88, 0x9B}};
  return id;
}

const TraceManifest& ETWManifest() {
  static const TraceManifest manifest = BuildManifest();
  return manifest;
}

}  // namespace LumenUtility
