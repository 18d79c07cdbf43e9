// Shared-memory data capture: a block written through a read/write view and read by a client
// through the read-only view, as the capture service and its clients do.
// guide:begin
#include <unistd.h>

#include <cstdio>
#include <string>

#include "lumen/capture.h"

int main() {
  const std::wstring name = L"VNASharedMemory_guide_" + std::to_wstring(getpid());
  FileMappingWithView<float> block(name, 4);  // 4 floats, zero when new
  for (std::uint32_t k = 0; k < 4; ++k) *block.GetPtr(k) = 0.5f * static_cast<float>(k);

  FileMappingReader client(name);  // what another process does with the block name
  std::printf("%lld bytes, %lld floats:", static_cast<long long>(client.GetByteSize()),
              static_cast<long long>(client.GetCount()));
  for (std::int64_t k = 0; k < client.GetCount(); ++k) std::printf(" %g", *client.GetPtr(k));
  std::printf("\n");

  try {
    FileMappingReader missing(L"VNASharedMemory_no_such_block");
  } catch (HRESULT hr) {
    std::printf("no such block: 0x%08X\n", static_cast<unsigned>(hr));
  }
  try {
    FileMappingWithView<float> bad(L"a/b", 4);
  } catch (HRESULT hr) {
    std::printf("bad name: 0x%08X\n", static_cast<unsigned>(hr));
  }
}
// guide:end
