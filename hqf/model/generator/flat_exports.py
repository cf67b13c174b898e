"""The whole list of the flat layer's exports."""

from __future__ import annotations

from flat_classes import class_exports
from flat_model import Export
from flat_own import own_exports
from flat_runtime import runtime_exports
from typed_model import Vocabulary


def flat_exports(vocabulary: Vocabulary) -> list[Export]:
    exports = own_exports() + runtime_exports() + class_exports(vocabulary)
    names = [export.name for export in exports]
    if len(set(names)) != len(names):
        raise ValueError("two exports of one name: " + ", ".join(sorted({n for n in names if names.count(n) > 1})))
    return exports
