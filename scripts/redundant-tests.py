#!/usr/bin/env python3
"""Lists the tests under tests/ that reach no library arc the rest of the suite
does not reach: candidates for merging or removal when trimming the suite.

Runs every test of the coverage build alone, with its gcc counters written to a
fresh directory, keeps the non-zero arc counters of the library's objects, and
then, largest test first, drops a test whenever every arc it reaches is still
reached by a test that stays. Tests against a real X server and the gallery's
own tests always stay. A listed test adds no coverage; whether it checks a
distinct behaviour is for the reader to judge, so nothing is edited here.

Usage: scripts/coverage.sh                  (builds build/coverage)
       scripts/redundant-tests.py [--keep REGEX]
The runs take the shared build lock; REGEX names tests that must stay (hostile
cases, for instance).
"""
import argparse
import collections
import fcntl
import json
import os
import re
import shutil
import struct
import subprocess
import tempfile

TAG_FUNCTION = 0x01000000
TAG_ARCS = 0x01a10000


def read_gcda(path, key, out):
    """Adds (object, function, counter) for each non-zero arc counter of one gcda file."""
    with open(path, 'rb') as f:
        data = f.read()
    if len(data) < 16 or struct.unpack_from('<I', data, 0)[0] != 0x67636461:
        return
    pos, function = 16, None  # magic, version, stamp, checksum
    while pos + 8 <= len(data):
        tag, length = struct.unpack_from('<Ii', data, pos)
        pos += 8
        if tag == 0:
            break
        if tag == TAG_ARCS and length < 0:
            continue  # all counters zero, none stored
        if tag == TAG_FUNCTION and length >= 4:
            function = struct.unpack_from('<I', data, pos)[0]
        elif tag == TAG_ARCS:
            for i, value in enumerate(struct.unpack_from('<%dq' % (length // 8), data, pos)):
                if value:
                    out.add((key, function, i))
        pos += max(length, 0)


def library_arcs(root):
    out = set()
    for folder, _, files in os.walk(root):
        for name in files:
            path = os.path.join(folder, name)
            key = os.path.relpath(path, root)
            if name.endswith('.gcda') and key.startswith('CMakeFiles/norvik_'):
                read_gcda(path, key, out)
    return out


def run_each_test(build):
    listing = json.loads(subprocess.check_output(['ctest', '--test-dir', build, '--show-only=json-v1']))
    strip = len([c for c in os.path.abspath(build).split('/') if c])
    results = {}
    scratch = tempfile.mkdtemp(prefix='norvik-arcs-')
    try:
        for test in listing['tests']:
            props = {p['name']: p['value'] for p in test.get('properties', [])}
            env = dict(os.environ, GCOV_PREFIX=os.path.join(scratch, 'run'), GCOV_PREFIX_STRIP=str(strip))
            for item in props.get('ENVIRONMENT') or []:
                k, v = item.split('=', 1)
                env[k] = v
            shutil.rmtree(env['GCOV_PREFIX'], ignore_errors=True)
            subprocess.run(test['command'], cwd=props.get('WORKING_DIRECTORY', build), env=env,
                           stdout=subprocess.DEVNULL, stderr=subprocess.DEVNULL, timeout=300)
            results[test['name']] = (library_arcs(env['GCOV_PREFIX']), props.get('LABELS') or [])
    finally:
        shutil.rmtree(scratch, ignore_errors=True)
    return results


def test_bodies():
    """(suite, name) -> (file, first line, last line) of every test under tests/."""
    bodies = {}
    for path in subprocess.check_output(['git', 'ls-files', 'tests/*.cpp']).decode().split():
        lines = open(path).read().split('\n')
        for i, line in enumerate(lines):
            m = re.match(r'TEST(?:_F|_P)?\((\w+),\s*(\w+)\)', line)
            if m:
                j = i
                while j < len(lines) and not lines[j].startswith('}'):
                    j += 1
                bodies[(m.group(1), m.group(2))] = (path, i + 1, j + 1)
    return bodies


def main():
    parser = argparse.ArgumentParser(description=__doc__.split('\n\n')[0])
    parser.add_argument('--build', default='build/coverage')
    parser.add_argument('--keep', default=None, help='regular expression of test names that must stay')
    args = parser.parse_args()
    os.chdir(os.path.join(os.path.dirname(os.path.abspath(__file__)), '..'))
    with open('/tmp/norvik-build.lock', 'w') as lock:
        fcntl.flock(lock, fcntl.LOCK_EX)
        results = run_each_test(args.build)
    bodies = test_bodies()
    keep = re.compile(args.keep) if args.keep else None
    units = collections.defaultdict(set)  # one unit per test body, over its parameter instances
    fixed = set()
    for name, (arcs, labels) in results.items():
        suite, rest = name.split('.', 1)
        key = (suite.split('/')[-1], rest.split('/')[0])
        body = bodies.get(key)
        if body and 'x11' not in labels and not body[0].startswith('tests/x11/') and \
                not (keep and keep.search(key[0] + '.' + key[1])):
            units[key] |= arcs
        else:
            fixed |= arcs
    reach = collections.Counter()
    for arcs in units.values():
        reach.update(arcs)
    listed = []
    for key in sorted(units, key=lambda k: bodies[k][1] - bodies[k][2]):
        if all(a in fixed or reach[a] > 1 for a in units[key]):
            reach.subtract(units[key])
            listed.append(key)
    total = 0
    for key in sorted(listed, key=lambda k: bodies[k]):
        path, first, last = bodies[key]
        total += last - first + 1
        print(f'{path}:{first}: {key[0]}.{key[1]} ({last - first + 1} lines)')
    print(f'{len(listed)} of {len(units)} tests reach no arc of their own ({total} lines)')


if __name__ == '__main__':
    main()
