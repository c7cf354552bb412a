# SPDX-License-Identifier: MIT
"""What makes the data files that ship. scripts/make-data says how a module takes part."""
