// SPDX-License-Identifier: MIT

// JACK's library and RtMidi order their memory in ways that ThreadSanitizer does not see, as they
// are not built with it. Other builds never call this.
extern "C" char const* __tsan_default_suppressions();
extern "C" char const* __tsan_default_suppressions() {
  return "race:libjack.so\n"
         "race:librtmidi.so\n";
}
