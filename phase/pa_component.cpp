#include "lumen/phase/pa_component.h"

#include <algorithm>
#include <climits>
#include <cstddef>

#include "lumen/platform/lumen_exception.h"
#include "phase/pa_averaging.h"
#include "phase/phase_host.h"
#include "phase/receiver_substitution.h"

using LumenUtility::TsComplex;

namespace {

// Completed values waiting for the FIFO, shared by every component of the process.
std::vector<TsComplex>& FifoStage() {
  static std::vector<TsComplex> stage;
  return stage;
}

// The smallest key with acquisition ID `id`: the map's order takes the ID first, then the
// receivers, where a reference receiver of the lowest index sorts first.
PAParameter FirstKeyOf(int id) {
  return PAParameter(INT_MIN, true, INT_MIN, true, id, false);
}

const std::vector<TsComplex>& EmptyValues() {
  static const std::vector<TsComplex> empty;
  return empty;
}

}  // namespace

PAComponent::PAComponent() {
  FifoStage().reserve(kFifoRun);
  LumenUtility::ReceiverSubstitution();
}

void PAComponent::AddParameter(const PAParameter& p) {
  if (m_parameters.try_emplace(p).second) CalculateUniqueIDs();
}

void PAComponent::ClearParameterData() {
  m_parameters.clear();
  CalculateUniqueIDs();
}

void PAComponent::CalculateUniqueIDs() {
  m_uniqueIDs.clear();
  for (const auto& entry : m_parameters) m_uniqueIDs.push_back(entry.first.id);
  std::sort(m_uniqueIDs.begin(), m_uniqueIDs.end());
  m_uniqueIDs.erase(std::unique(m_uniqueIDs.begin(), m_uniqueIDs.end()), m_uniqueIDs.end());
  // A shorter list must not leave the cycle pointing past its end.
  if (m_currentIDIndex >= static_cast<int>(m_uniqueIDs.size())) m_currentIDIndex = 0;
}

void PAComponent::SetSweepParameters(int points, bool /*unused*/, int averagingCount) {
  if (points < 0) throw LumenException(LumenUtility::E_INVALIDARG, L"negative number of points");
  // Asked for the host's sake only; the answer is not needed here.
  if (ITestSet* testSet = LumenUtility::FindTestSet()) testSet->GetPortCount();
  for (auto& entry : m_parameters) {
    PAParameterRecord& record = entry.second;
    record.values.resize(static_cast<std::size_t>(points));
    record.count.store(0, std::memory_order_release);
    record.begin = 0;
  }
  m_averagingCount = averagingCount;
  m_averagingIndex = 0;
  m_stitch.StartOfSweep();
}

void PAComponent::PutData(const TsComplex* points, int count, int stride, bool mappingFlag,
                          bool toFifo) {
  if (points == nullptr || count < 1) return;
  // Host objects first, so that a missing one leaves every counter as it was.
  if (!m_parameters.empty()) LumenUtility::RequireTestSet();
  if (toFifo && (!m_parameters.empty() || !FifoStage().empty())) LumenUtility::RequireFifo();

  // The caller's buffers are the acquisition's scratch: substitution and stitching work in
  // place.
  TsComplex* buffers = const_cast<TsComplex*>(points);
  const auto& substitution = LumenUtility::ReceiverSubstitution();
  if (!substitution.empty() && m_referenceReceiverIndex == 1) {
    LumenUtility::ApplyReceiverSubstitution(substitution, buffers, count, stride);
  }

  const int blockSize = std::max(m_averagingCount, 1);
  for (int k = 0; k < count; ++k) {
    TsComplex* point = buffers + static_cast<std::ptrdiff_t>(k) * stride;
    if (m_stitch.ApplyStitch(point)) continue;  // discarded: no counter moves
    CollectPoint(point, mappingFlag, toFifo);
    if (++m_averagingIndex >= blockSize) {
      m_averagingIndex = 0;
      if (!m_uniqueIDs.empty()) {
        m_currentIDIndex = (m_currentIDIndex + 1) % static_cast<int>(m_uniqueIDs.size());
      }
    }
  }
  if (toFifo) FlushToFifo();
}

void PAComponent::CollectPoint(const TsComplex* point, bool mappingFlag, bool toFifo) {
  if (m_uniqueIDs.empty()) return;
  const int id = m_uniqueIDs[m_currentIDIndex];
  const int blockSize = std::max(m_averagingCount, 1);
  const bool completes = m_averagingIndex + 1 == blockSize;
  for (auto it = m_parameters.lower_bound(FirstKeyOf(id));
       it != m_parameters.end() && it->first.id == id; ++it) {
    const PAParameter& parameter = it->first;
    PAParameterRecord& record = it->second;
    TsComplex sample;
    parameter.RatioBucket(point, sample, mappingFlag);

    // Only this thread writes the count, so its own reads need no ordering.
    const std::int32_t completed = record.count.load(std::memory_order_relaxed);
    TsComplex* target;
    if (completed >= 0 && static_cast<std::size_t>(completed) < record.values.size()) {
      target = &record.values[static_cast<std::size_t>(completed)];
    } else if (toFifo) {
      target = &record.spill;
    } else {
      continue;  // the array is full: the value has nowhere to go
    }
    if (parameter.ratioed) {
      LumenUtility::FoldComplexMean(*target, sample, m_averagingIndex, blockSize);
    } else {
      LumenUtility::FoldPowerAndPhase(*target, record.phasorSum, sample, m_averagingIndex,
                                      blockSize);
    }
    if (!completes) continue;
    if (toFifo) {
      WriteToFifo(*target);  // the same element takes the next block
    } else {
      // Publishes the completed value to a consumer that loads the count.
      record.count.fetch_add(1, std::memory_order_release);
    }
  }
}

void PAComponent::WriteToFifo(TsComplex value) {
  std::vector<TsComplex>& stage = FifoStage();
  stage.push_back(value);
  if (stage.size() >= static_cast<std::size_t>(kFifoRun)) FlushToFifo();
}

void PAComponent::FlushToFifo() {
  std::vector<TsComplex>& stage = FifoStage();
  if (stage.empty()) return;
  // Emptied only once the FIFO has taken the values: a FIFO that throws loses none.
  LumenUtility::RequireFifo().Write(stage.data(), static_cast<int>(stage.size()));
  stage.clear();
}

int PAComponent::GetAvailableDataCount(const PAParameter& p) {
  const auto it = m_parameters.find(p);
  if (it == m_parameters.end()) return -1;
  const int available = it->second.count.load(std::memory_order_acquire);
  it->second.begin = available;
  return available;
}

int PAComponent::GetBegin(const PAParameter& p) const {
  const auto it = m_parameters.find(p);
  return it == m_parameters.end() ? -1 : it->second.begin;
}

const std::vector<TsComplex>& PAComponent::GetDataByRef(const PAParameter& p) const {
  const auto it = m_parameters.find(p);
  return it == m_parameters.end() ? EmptyValues() : it->second.values;
}

bool PAComponent::IsParameterAvailable(const PAParameter& p) const {
  return m_parameters.count(p) != 0;
}

std::vector<PAReceiver> PAComponent::GetReceivers() const {
  std::vector<PAReceiver> receivers;
  for (const auto& entry : m_parameters) {
    receivers.push_back(entry.first.numerator);
    if (entry.first.ratioed) receivers.push_back(entry.first.denominator);
  }
  return receivers;
}

void PAComponent::SetPhaseStitch(PAParameter& p, const std::vector<int>& breaks,
                                 int pointsPerBreak, int leadingPoints, bool hasReferencePoints) {
  const int slot = p.GetNumeratorSlot(false);
  m_stitch.SetState(true, breaks, pointsPerBreak, leadingPoints, slot, hasReferencePoints);
}
