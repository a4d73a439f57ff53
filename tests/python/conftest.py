"""The package under test comes from the source tree and finds the built library through PIGMO_LIBRARY."""

import os
from pathlib import Path

import pytest


@pytest.fixture(scope="session")
def palette_dir() -> Path:
    return Path(os.environ.get("PIGMO_SOURCE_DIR", Path(__file__).resolve().parents[2])) / "palettes"
