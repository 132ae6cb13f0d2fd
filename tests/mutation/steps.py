"""What trials of C++ and of Java mutants have in common."""

import collections

COMPILE_SECONDS = 120
HANG_FACTOR = 5  # times what the tests take without a mutant, and at least HANG_SECONDS
HANG_SECONDS = 2
PROOF_FACTOR = 100  # times what the one test takes without a mutant, and at least PROOF_SECONDS
PROOF_SECONDS = 5

# What became of a mutant, which step or test said so, and the processor seconds of it all.
Fate = collections.namedtuple("Fate", "fate by seconds")


class StepFailed(Exception):
    """A step that has to succeed did not."""


class Settled(Exception):
    """The fate of a mutant is known."""

    def __init__(self, fate, by=""):
        self.fate = fate
        self.by = by
