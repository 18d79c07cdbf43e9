// The saved form of the global state: its bytes, its reload, and archives that are damaged.
#include <gtest/gtest.h>

#include <cmath>
#include <cstdint>
#include <string>
#include <vector>

#include "globalstate/fake_host.h"
#include "lumen/globalstate/global_state.h"
#include "lumen/platform/archive.h"
#include "lumen/platform/lumen_exception.h"
#include "lumen/platform/mem_file.h"
#include "lumen/platform/text_conversion.h"
#include "stimulus/golden_bytes.h"

namespace LumenUtility {
namespace {

using testutil::Bytes;
using testutil::Events;
using testutil::Golden;

// A wide string in the archive's tagged form, for texts under 255 ASCII characters: 0xFF,
// the tag 0xFFFE, the unit count in one byte, then UTF-16LE units.
Bytes Tagged(const std::string& ascii) {
  Bytes bytes{0xFF, 0xFE, 0xFF, static_cast<unsigned char>(ascii.size())};
  for (const char c : ascii) {
    bytes.push_back(static_cast<unsigned char>(c));
    bytes.push_back(0);
  }
  return bytes;
}

// A record of version 1 with the given entries, in the given order.
Bytes Record(const std::vector<std::pair<std::string, std::string>>& entries,
             std::uint32_t version = 1) {
  Golden golden;
  golden.Put(version).Put(static_cast<std::uint32_t>(entries.size()));
  for (const auto& [key, value] : entries) golden.Append(Tagged(key)).Append(Tagged(value));
  return golden.bytes;
}

Bytes Save() {
  CMemFile file;
  CArchive ar(&file, CArchive::store);
  GlobalState::SerializeGlobalState(ar);
  ar.Close();
  return file.Detach();
}

void Load(const Bytes& bytes) {
  CMemFile file(bytes);
  CArchive ar(&file, CArchive::load);
  GlobalState::SerializeGlobalState(ar);
}

class GlobalStateArchive : public testutil::GlobalStateFixture {
 protected:
  static const GlobalStateTable::Settings& Settings() {
    return GlobalStateTable::Instance().GetSettings();
  }
};

TEST_F(GlobalStateArchive, SavedSettingsAreVersionCountAndEntriesInKeyOrder) {
  GlobalState::SetPowerKnobResolution(0.25);
  GlobalState::SetIndexLinePolarity(GlobalState::IndexLineNegative);
  GlobalState::SetExternalReference(L"External");  // never saved
  const Bytes expected = Golden()
                             .Append({0x01, 0x00, 0x00, 0x00, 0x02, 0x00, 0x00, 0x00})
                             .Append({0xFF, 0xFE, 0xFF, 0x0D, 'I', 0, 'n', 0, 'd', 0, 'e', 0, 'x',
                                      0, 'P', 0, 'o', 0, 'l', 0, 'a', 0, 'r', 0, 'i', 0, 't', 0,
                                      'y', 0})
                             .Append(Tagged("Negative"))
                             .Append(Tagged("PowerKnobResolution"))
                             .Append(Tagged("0.250000"))
                             .bytes;
  EXPECT_EQ(Save(), expected);
  GlobalState::PresetGlobalState();
  EXPECT_EQ(Save(), (Bytes{1, 0, 0, 0, 0, 0, 0, 0}));
}

TEST_F(GlobalStateArchive, ReloadRestoresTheSettingsQuietlyAndKeepsTheReference) {
  GlobalState::SetPowerKnobResolution(0.25);
  GlobalState::SetIndexLinePolarity(GlobalState::IndexLineNegative);
  GlobalState::SetEquationEditorFastProcessingMode(true);
  const Bytes saved = Save();
  GlobalState::PresetGlobalState();
  GlobalState::SetPowerKnobResolution(3.0);
  GlobalState::SetExternalReference(L"External");
  Events().clear();

  Load(saved);
  EXPECT_EQ(GlobalState::GetPowerKnobResolution(), 0.25);
  EXPECT_EQ(GlobalState::GetIndexLinePolarity(), GlobalState::IndexLineNegative);
  EXPECT_TRUE(GlobalState::GetEquationEditorFastProcessingMode());
  EXPECT_EQ(GlobalState::GetExternalReference(), L"External");
  EXPECT_TRUE(Events().empty());
  EXPECT_EQ(Save(), saved);
}

TEST_F(GlobalStateArchive, NewerVersionIsRefusedAndChangesNothing) {
  GlobalState::SetPowerKnobResolution(2.0);
  for (const std::uint32_t version : {2u, 3u, 0x80000000u, 0xFFFFFFFFu}) {
    SCOPED_TRACE(version);
    try {
      Load(Record({{"IndexPolarity", "Negative"}}, version));
      ADD_FAILURE() << "loaded";
    } catch (const LumenException& e) {
      EXPECT_EQ(e.GetCode(), LUMEN_E_UNKNOWN_VERSION);
      EXPECT_TRUE(e.GetMessages().empty());
    }
    EXPECT_EQ(Settings(), (GlobalStateTable::Settings{{L"PowerKnobResolution", L"2.000000"}}));
  }
  Load(Record({{"IndexPolarity", "Negative"}}, 0));  // an older version loads
  EXPECT_EQ(GlobalState::GetIndexLinePolarity(), GlobalState::IndexLineNegative);
}

TEST_F(GlobalStateArchive, ReferenceEntryInAnArchiveIsIgnored) {
  Load(Record({{"IndexPolarity", "Negative"}, {"ReferenceState", "External"}}));
  EXPECT_EQ(GlobalState::GetExternalReference(), L"Internal");
  EXPECT_EQ(Settings(), (GlobalStateTable::Settings{{L"IndexPolarity", L"Negative"}}));
  EXPECT_FALSE(hardware.external);
}

TEST_F(GlobalStateArchive, InvalidValueRefusesTheWholeArchive) {
  GlobalState::SetEquationEditorFastProcessingMode(false);
  const GlobalStateTable::Settings before = Settings();
  const struct {
    const char* key;
    const char* value;
  } cases[] = {
      {"IndexPolarity", "Positive"},     {"IndexPolarity", "negative"},
      {"IndexPolarity", ""},             {"EquationEditorFastProcessing", "true"},
      {"EquationEditorFastProcessing", "1"}, {"PowerKnobResolution", "abc"},
      {"PowerKnobResolution", ""},       {"PowerKnobResolution", " 0.1"},
      {"PowerKnobResolution", "0.1dB"},  {"PowerKnobResolution", "nan"},
      {"PowerKnobResolution", "inf"},    {"PowerKnobResolution", "1e999"},
      {"PowerKnobResolution", "0x10"},   {"PowerKnobResolution", "+-1"},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(std::string(c.key) + "=" + c.value);
    try {
      // The valid entry in front must not be taken either.
      Load(Record({{"EquationEditorFastProcessing", "True"}, {c.key, c.value}}));
      ADD_FAILURE() << "loaded";
    } catch (const LumenException& e) {
      EXPECT_EQ(e.GetCode(), LUMEN_E_BOUNDS);
      EXPECT_EQ(e.GetMessage(), L"global state setting \"" + Utf8ToWide(c.key) + L"\" cannot be \"" +
                                    Utf8ToWide(c.value) + L"\"");
    }
    EXPECT_EQ(Settings(), before);
  }
}

TEST_F(GlobalStateArchive, NumbersInOtherSpellingsAndUnknownKeysLoad) {
  Load(Record({{"PowerKnobResolution", "+2.5e-1"}, {"FutureSetting", "anything"}}));
  EXPECT_EQ(GlobalState::GetPowerKnobResolution(), 0.25);
  // A setting of another version is carried along and saved again as it came.
  EXPECT_EQ(Save(), Record({{"FutureSetting", "anything"}, {"PowerKnobResolution", "+2.5e-1"}}));
  Load(Record({{"PowerKnobResolution", "-3"}}));
  EXPECT_EQ(GlobalState::GetPowerKnobResolution(), -3.0);
}

TEST_F(GlobalStateArchive, LaterEntryOfTheSameKeyWins) {
  Load(Record({{"PowerKnobResolution", "1"}, {"PowerKnobResolution", "2"}}));
  EXPECT_EQ(GlobalState::GetPowerKnobResolution(), 2.0);
}

// Damaged copies of a valid archive: each must either be refused with the settings as they
// were, or load settings that every reader takes and that save and load again unchanged.
class CorruptedGlobalStateArchive : public GlobalStateArchive {
 protected:
  void SetUp() override {
    GlobalStateArchive::SetUp();
    m_valid = Record({{"EquationEditorFastProcessing", "False"},
                      {"IndexPolarity", "Negative"},
                      {"PowerKnobResolution", "0.250000"}});
    GlobalState::SetPowerKnobResolution(7.0);
    m_before = Settings();
  }

  // Loads `bytes`; returns true when they loaded. A refusal must be one of the archive's own
  // errors and leave the settings as they were.
  bool LoadDamaged(const Bytes& bytes) {
    try {
      Load(bytes);
    } catch (const LumenException&) {
      EXPECT_EQ(Settings(), m_before);
      return false;
    } catch (const CArchiveException& e) {
      EXPECT_EQ(e.m_cause, CArchiveException::endOfFile);
      EXPECT_EQ(Settings(), m_before);
      return false;
    }
    // Every reader takes what loaded, and it saves and loads again to the same bytes.
    GlobalState::GetIndexLinePolarity();
    GlobalState::GetEquationEditorFastProcessingMode();
    EXPECT_TRUE(std::isfinite(GlobalState::GetPowerKnobResolution()));
    const Bytes again = Save();
    Load(again);
    EXPECT_EQ(Save(), again);
    GlobalStateTable::Instance().ReplaceSettings(m_before);
    return true;
  }

  Bytes m_valid;
  GlobalStateTable::Settings m_before;
};

TEST_F(CorruptedGlobalStateArchive, EveryTruncationIsRefused) {
  for (std::size_t size = 0; size < m_valid.size(); ++size) {
    SCOPED_TRACE(size);
    EXPECT_FALSE(LoadDamaged(Bytes(m_valid.begin(), m_valid.begin() + size)));
  }
  EXPECT_TRUE(LoadDamaged(m_valid));
}

TEST_F(CorruptedGlobalStateArchive, EveryChangedByteIsRefusedOrLoadsValidSettings) {
  int refused = 0;
  int loaded = 0;
  for (std::size_t at = 0; at < m_valid.size(); ++at) {
    for (const unsigned char mask : {0x01, 0x20, 0x80, 0xFF}) {
      SCOPED_TRACE(testing::Message() << "byte " << at << " ^ " << int(mask));
      Bytes damaged = m_valid;
      damaged[at] ^= mask;
      (LoadDamaged(damaged) ? loaded : refused)++;
    }
  }
  // Both outcomes occur: a changed letter of a key loads as another key, a changed value of
  // a known key is refused.
  EXPECT_GT(refused, 0);
  EXPECT_GT(loaded, 0);
}

TEST_F(CorruptedGlobalStateArchive, CountBeyondTheDataEndsAtTheArchivesEnd) {
  Bytes bytes = m_valid;
  bytes[4] = bytes[5] = bytes[6] = bytes[7] = 0xFF;  // 4294967295 entries
  EXPECT_FALSE(LoadDamaged(bytes));
  bytes.resize(8);
  EXPECT_FALSE(LoadDamaged(bytes));
}

}  // namespace
}  // namespace LumenUtility
