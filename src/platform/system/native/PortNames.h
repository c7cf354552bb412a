// SPDX-License-Identifier: MIT
#pragma once

#include <set>
#include <string>

namespace Ostinet::Impl {

/// What fits `szPname`, without its terminating zero.
inline constexpr std::size_t kMaxPortName = 31;

/// The name for people of an ALSA sequencer port that is listed as "Client:Port 20:0": without the
/// two numbers, which change from boot to boot, and without the client where the port's own name
/// begins with it.
std::string AlsaPortName(std::string const& id);

/// The name for people of a JACK port "client:port". Bridges of the ALSA sequencer put its client's
/// number in the name ("a2j:Synth [20] (capture): Synth MIDI 1"); number and bridge go.
std::string JackPortName(std::string const& id);

/// UTF-16 of at most kMaxPortName units. Where "Client:Port" is too long the client is shortened,
/// because it is the port that tells one from another. Malformed UTF-8 becomes U+FFFD.
std::u16string FitPortName(std::string const& name);

/// `name`, or when it is taken `name` with " 2", " 3"... at its end, still within kMaxPortName.
std::u16string MakePortNameUnique(std::u16string const& name,
                                  std::set<std::u16string> const& taken);

}  // namespace Ostinet::Impl
