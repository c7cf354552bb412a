// SPDX-License-Identifier: MIT
#include "BenchHost.h"

#include <cstdio>
#include <cstdlib>

namespace Ostinet::Bench {
namespace {

class BenchCallbacks : public OstinetCallbackAPI {
 public:
  double GetSampleTime(unsigned long long hostClocks) override {
    return static_cast<double>(hostClocks);
  }
  Provider<Impl::WinMIDIDevicesListener>* GetDevicesProvider() override { return &provider_; }

 private:
  Provider<Impl::WinMIDIDevicesListener> provider_;
};

Impl::WinMIDISetup& TheSetup() {
  static BenchCallbacks callbacks;
  OstinetCallbackAPI::gInstance = &callbacks;
  return static_cast<Impl::WinMIDISetup&>(Setup::Instance());
}

[[noreturn]] void Fail(std::string const& what) {
  std::fprintf(stderr, "bench: %s\n", what.c_str());
  std::exit(1);
}

}  // namespace

BenchHost::BenchHost() : setup(TheSetup()) {
  midi.SetRecording(false);
  midi.SetNotifying(false);
  midi.Install();
}

BenchHost::~BenchHost() {
  setup.SignOut(false);
  midi.Remove();
}

void BenchHost::AddPort(std::string const& name, SimulatedPort::Kind kind) {
  SimulatedPort port;
  port.name = name;
  port.kind = kind;
  port.external = true;
  midi.AddPort(port);
}

void BenchHost::SignIn() {
  if (setup.SignIn(UString("Bench"), &receiver, nullptr) != Setup::kSignInOK) {
    Fail("the sign-in failed");
  }
}

Destination BenchHost::Dest(std::string const& name) const {
  for (int i = 0; i < setup.CountDestinations(); ++i) {
    if (setup.GetDestination(i).GetName() == UString(name.c_str())) {
      return setup.GetDestination(i);
    }
  }
  Fail("there is no destination " + name);
}

}  // namespace Ostinet::Bench
