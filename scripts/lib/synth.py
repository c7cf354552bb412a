#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
"""Plays a real synthesizer by the names of its patches.

A JACK server without sound, fluidsynth behind it with a small sound font, and the tool: patches are
selected by name from the General MIDI document that ships, fluidsynth is asked what its channels
play, and what it plays is recorded. Selecting another name must change the program that fluidsynth
reports, and the sound.

    synth.py TOOL        exit code 0: it does; 1: it does not; 77: there is no JACK server here
"""

import array
import math
import os
import re
import shutil
import signal
import subprocess
import sys
import tempfile
import time
import wave

SOUND_FONT = "/usr/share/sounds/sf2/TimGM6mb.sf2"
SERVER = f"ostinet-synth-{os.getpid()}"
RATE = 48000
AUDIO_PORT = "fluid:left"
SKIP = 77
# What is selected, and the program that it means.
PATCHES = [("Violin", 40), ("Acoustic Grand Piano", 0), ("Church Organ", 19)]


class Skip(Exception):
    """There is nothing to test with."""


class Fault(Exception):
    """It does not work."""


def wait_until(condition, seconds, what):
    deadline = time.monotonic() + seconds
    while not condition():
        if time.monotonic() > deadline:
            raise Fault(f"{what} within {seconds} s")
        time.sleep(0.05)


def environment(folder):
    return dict(os.environ, JACK_DEFAULT_SERVER=SERVER, JACK_NO_AUDIO_RESERVATION="1",
                XDG_DATA_HOME=folder, HOME=folder)


class Children:
    """The programs that this one started; they end with it."""

    def __init__(self, env):
        self.env = env
        self.running = []

    def start(self, *command, **options):
        options = {"stdout": subprocess.DEVNULL, "stderr": subprocess.DEVNULL, **options}
        child = subprocess.Popen(command, env=self.env, **options)
        self.running.append(child)
        return child

    def end(self):
        for child in reversed(self.running):
            child.send_signal(signal.SIGTERM)
            try:
                child.wait(5)
            except subprocess.TimeoutExpired:
                child.kill()
                child.wait()


def start_jack(children, env):
    server = children.start("jackd", "-S", "--no-realtime", "-n", SERVER, "-d", "dummy",
                            "-r", str(RATE), "-p", "1024")
    deadline = time.monotonic() + 10
    while subprocess.run(["jack_lsp"], env=env, stdout=subprocess.DEVNULL,
                         stderr=subprocess.DEVNULL, check=False).returncode:
        if server.poll() is not None or time.monotonic() > deadline:
            raise Skip("no JACK server can be started here")
        time.sleep(0.1)


class Synth:
    """fluidsynth, with its own shell."""

    def __init__(self, children, folder):
        self.answers = os.path.join(folder, "fluidsynth.txt")
        self.child = children.start(
            "fluidsynth", "-q", "-r", str(RATE), "-a", "jack", "-m", "jack",
            "-o", "audio.jack.id=fluid", "-o", f"audio.jack.server={SERVER}",
            "-o", "midi.jack.id=fluid", "-o", f"midi.jack.server={SERVER}", SOUND_FONT,
            stdin=subprocess.PIPE, stdout=open(self.answers, "wb"), text=True)

    def channels(self):
        """{channel from 0: (program, name)}"""
        with open(self.answers, encoding="utf-8", errors="replace") as file:
            before = len(file.read())
        self.child.stdin.write("channels -verbose\n")
        self.child.stdin.flush()
        found = {}

        def is_answered():
            with open(self.answers, encoding="utf-8", errors="replace") as file:
                text = file.read()[before:]
            for match in re.finditer(r"chan (\d+), .*?preset (\d+), (.*)", text):
                found[int(match[1])] = (int(match[2]), match[3].strip())
            return 15 in found

        wait_until(is_answered, 10, "fluidsynth does not tell its channels")
        return found


class Tool:
    def __init__(self, program, folder, env):
        self.command = [program, "--settings", os.path.join(folder, "settings")]
        self.env = env

    def run(self, *arguments):
        result = subprocess.run([*self.command, *arguments], env=self.env, capture_output=True,
                                text=True, timeout=60, check=False)
        if result.returncode:
            raise Fault(f"ostinet {' '.join(arguments)}: {result.stderr.strip()}")
        return result.stdout


def record(env, port, path, play):
    """What leaves `port` in the second in which `play` runs, as numbers."""
    recorder = subprocess.Popen(["jack_rec", "-f", path, "-d", "2", "-b", "16", port], env=env,
                                stdout=subprocess.DEVNULL, stderr=subprocess.DEVNULL)
    time.sleep(0.3)
    play()
    if recorder.wait(20):
        raise Fault("jack_rec cannot record")
    with wave.open(path) as file:
        samples = array.array("h", file.readframes(file.getnframes()))
    return [sample / 32768 for sample in samples]


def loudness(samples):
    return math.sqrt(sum(sample * sample for sample in samples) / max(len(samples), 1))


def colour(samples):
    """How the energy of the overtones of C4 spreads, the loudest part of a second."""
    start = max(range(0, max(len(samples) - RATE // 2, 1), RATE // 20),
                key=lambda at: loudness(samples[at:at + RATE // 2]))
    part = samples[start:start + RATE // 2]
    energies = []
    for overtone in range(1, 13):
        step = 2 * math.pi * 261.63 * overtone / RATE
        real = sum(sample * math.cos(step * i) for i, sample in enumerate(part))
        imaginary = sum(sample * math.sin(step * i) for i, sample in enumerate(part))
        energies.append(math.hypot(real, imaginary))
    size = math.sqrt(sum(energy * energy for energy in energies)) or 1
    return [energy / size for energy in energies]


def likeness(a, b):
    return sum(x * y for x, y in zip(a, b))


def is_up(env):
    ports = subprocess.run(["jack_lsp"], env=env, capture_output=True, text=True,
                           check=False).stdout.split("\n")
    return AUDIO_PORT in ports


def play_patches(tool, synth, env, folder):
    destination = "fluid"
    tool.run("names", destination, "--standard", "General MIDI")
    colours = {}
    for name, program in PATCHES:
        tool.run("select", destination, "1", name)
        wait_until(lambda: synth.channels()[0][0] == program, 5,
                   f"after \"{name}\" fluidsynth does not report program {program}")
        samples = record(env, AUDIO_PORT, os.path.join(folder, "sound.wav"),
                         lambda: tool.run("send", destination, "on", "C4", "110", "--at", "+900",
                                          "off", "C4"))
        if loudness(samples) < 0.001:
            raise Fault(f"\"{name}\" is silent")
        colours[name] = colour(samples)
        print(f"{name}: program {program}, heard")
    for name, _ in PATCHES[1:]:
        alike = likeness(colours[PATCHES[0][0]], colours[name])
        if alike > 0.98:
            raise Fault(f"\"{name}\" sounds as {PATCHES[0][0]} does ({alike:.3f})")
    tool.run("select", destination, "10", "1")
    print("channel 10:", synth.channels()[9][1])


def run(program):
    for needed in ("jackd", "jack_lsp", "jack_rec", "fluidsynth"):
        if shutil.which(needed) is None:
            raise Skip(f"{needed} is not installed")
    if not os.path.exists(SOUND_FONT):
        raise Skip("the sound font is not installed")
    with tempfile.TemporaryDirectory() as folder:
        env = environment(folder)
        children = Children(env)
        try:
            start_jack(children, env)
            synth = Synth(children, folder)
            wait_until(lambda: is_up(env), 20, "fluidsynth does not come up on JACK")
            play_patches(Tool(program, folder, env), synth, env, folder)
        finally:
            children.end()


def main():
    try:
        run(sys.argv[1])
        return 0
    except Skip as skip:
        print(f"skipped: {skip}")
        return SKIP
    except Fault as fault:
        print(fault, file=sys.stderr)
        return 1


if __name__ == "__main__":
    sys.exit(main())
