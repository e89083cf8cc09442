# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0
"""Writing generated files."""

from __future__ import annotations

from pathlib import Path

CPP_NOTICE = """\
// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
//
// Generated from catalogue/functions.toml by tools/generate.

"""


class Output:
    """A folder of generated files. Files that would not change are not touched, so that nothing is
    rebuilt for them; files of an earlier run that are no longer made are removed."""

    def __init__(self, root: Path) -> None:
        self.root = root
        self.written: set[Path] = set()

    def write(self, name: str, text: str) -> None:
        path = self.root / name
        self.written.add(path)
        if path.exists() and path.read_text() == text:
            return
        path.parent.mkdir(parents=True, exist_ok=True)
        path.write_text(text)

    def cpp(self, name: str, text: str) -> None:
        self.write(name, CPP_NOTICE + text)

    def remove_stale(self) -> None:
        for path in list(self.root.rglob("*")):
            if path.is_file() and path not in self.written:
                path.unlink()
