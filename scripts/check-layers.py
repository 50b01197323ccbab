#!/usr/bin/env python3
"""Prints which folder of src/ includes which, and fails when the folders include each other in
a cycle. Each folder is a library of its own (cmake/ZorbinLayers.cmake); a cycle would mean that
two of them can only be understood, built and tested together.

Usage: scripts/check-layers.py [SRC_DIR]
"""
import os
import re
import sys

INCLUDE = re.compile(r'^\s*#\s*include\s+"([A-Za-z0-9_]+)/')


def include_graph(src):
    graph = {}
    for folder in sorted(os.listdir(src)):
        top = os.path.join(src, folder)
        if not os.path.isdir(top):
            continue
        edges = graph.setdefault(folder, {})
        for directory, _, files in os.walk(top):
            for name in files:
                if not name.endswith(('.h', '.cpp')):
                    continue
                with open(os.path.join(directory, name), encoding='utf-8') as source:
                    for line in source:
                        match = INCLUDE.match(line)
                        if match and match.group(1) != folder and os.path.isdir(os.path.join(src, match.group(1))):
                            edges[match.group(1)] = edges.get(match.group(1), 0) + 1
    return graph


def find_cycle(graph):
    """One cycle as a list of folders, or None."""
    state = {}
    path = []

    def visit(folder):
        state[folder] = 'open'
        path.append(folder)
        for target in sorted(graph.get(folder, {})):
            if state.get(target) == 'open':
                return path[path.index(target):] + [target]
            if target not in state:
                cycle = visit(target)
                if cycle:
                    return cycle
        path.pop()
        state[folder] = 'done'
        return None

    for folder in sorted(graph):
        if folder not in state:
            cycle = visit(folder)
            if cycle:
                return cycle
    return None


def main():
    src = sys.argv[1] if len(sys.argv) > 1 else os.path.join(os.path.dirname(os.path.abspath(__file__)), '..', 'src')
    graph = include_graph(src)
    for folder, edges in graph.items():
        targets = ', '.join(f'{target} ({count})' for target, count in sorted(edges.items()))
        print(f'{folder:10} -> {targets or "-"}')
    cycle = find_cycle(graph)
    if cycle:
        print('The folders include each other in a cycle: ' + ' -> '.join(cycle), file=sys.stderr)
        return 1
    print('No cycle among the folders of src/.')
    return 0


if __name__ == '__main__':
    sys.exit(main())
