#!/usr/bin/env python3
"""Fails when the module's component folders include each other in a circle.

Every '#include "Folder/..."' of a file in one folder is an edge to that folder; the base
folder and the host interface may be included by all, and include no component themselves.
Prints the folders in an order that respects the edges, or the circle it found."""
import re
import sys
from pathlib import Path

root = Path(sys.argv[1] if len(sys.argv) > 1 else "ICodeTestFrame")
include = re.compile(r'^\s*#\s*include\s+"([A-Za-z]+)/', re.M)
edges = {}
for path in root.rglob("*"):
    if path.suffix not in {".h", ".cpp", ".def", ".re", ".y"} or path.parent == root:
        continue
    folder = path.relative_to(root).parts[0]
    targets = edges.setdefault(folder, set())
    for target in include.findall(path.read_text(errors="replace")):
        if target != folder and (root / target).is_dir():
            targets.add(target)

order, state = [], {}


def visit(folder, trail):
    if state.get(folder) == "done":
        return
    if state.get(folder) == "open":
        circle = trail[trail.index(folder):] + [folder]
        sys.exit("folders include each other: " + " -> ".join(circle))
    state[folder] = "open"
    for target in sorted(edges.get(folder, ())):
        visit(target, trail + [folder])
    state[folder] = "done"
    order.append(folder)


for folder in sorted(edges):
    visit(folder, [])
for base in ("ItfBase", "ItfHostInterface"):
    leaked = sorted(edges.get(base, set()) - {"ItfBase", "ItfHostInterface"})
    if leaked:
        sys.exit(f"{base} includes components: {', '.join(leaked)}")
print("dependency order: " + " ".join(order))
