// SPDX-License-Identifier: MIT
//
// Arbitrary bytes as a setup file. Start it on tests/corpus/setup_file.
#include <cstdlib>
#include <filesystem>

#include "SetupFileInput.h"
#include "ostinet/SimulatedMIDI.h"

namespace {

using namespace Ostinet;

/// A host that keeps nothing but the setup file.
class FuzzedHost : public OstinetCallbackAPI, public PrefsHandler {
 public:
  FuzzedHost() {
    std::filesystem::create_directories(folder_);
    gInstance = this;
    midi_.Install();
  }
  double GetSampleTime(unsigned long long) override { return 0.0; }
  Provider<Impl::WinMIDIDevicesListener>* GetDevicesProvider() override { return &provider_; }
  void Save(int, std::vector<unsigned char> const&) override {}
  void Load(int, std::vector<unsigned char>& bytes) override { bytes.clear(); }
  void GetFolder(Folder& out) override {
    out = Folder(FileSpecification(UString(folder_.u16string())));
  }

 private:
  std::filesystem::path const folder_ =
      std::filesystem::temp_directory_path() / "ostinet-fuzz-setup-file";
  Provider<Impl::WinMIDIDevicesListener> provider_;
  SimulatedMIDI midi_;
};

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(std::uint8_t const* bytes, std::size_t count) {
  static FuzzedHost* const host = new FuzzedHost;  // outlives the setup
  if (!Fuzz::TrySetupFile(Setup::Instance(), *host, bytes, count)) {
    std::abort();
  }
  return 0;
}
