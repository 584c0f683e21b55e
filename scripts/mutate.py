#!/usr/bin/env python3
"""Mutation testing: how many small faults in the product code do the tests catch?

Makes mutants of the product's C++ sources (one small change each), applies
each in a scratch copy of the tree with its own build folder, rebuilds, runs
the ctest labels that cover the changed folder and classifies the mutant:

  killed      a test failed
  survived    every test passed: the change went unnoticed
  no-compile  the mutant does not build (not counted in the score)
  timed-out   the tests ran longer than the limit (counted as killed)

Usage:
  scripts/mutate.py [--seed N] [--per-file N] [--minutes M] [--area A ...]
                    [--since REV] [--sample N] [--list] [--keep] [--results FILE]

  --area A      only mutate this product folder (repeatable): epsconvert,
                plugin, db, clientapp, utils, settings_core, settings_ui, sdk, host, printing,
                posix
  --per-file N  at most N mutants drawn from each file (default 3)
  --since REV   only mutate lines added or changed since the git revision REV
                (what a piece of work changed), each file's share drawn from
                those lines alone
  --sample N    at most N mutants in all, drawn evenly across the areas
  --minutes M   stop starting new mutants after M minutes (default: no limit)
  --seed N      sampling seed (default 1); the same seed and tree give the
                same mutants
  --list        print the sampled mutants and stop
  --keep        keep the scratch tree (default: removed at the end)
  --results F   also write every result as TSV to F

Not part of CI: a run over a few hundred mutants takes hours on two cores.
ccache keeps the rebuilds cheap.
"""
import argparse
import os
import random
import re
import shutil
import signal
import subprocess
import sys
import tempfile
import time
from collections import OrderedDict, defaultdict

ROOT = os.path.dirname(os.path.dirname(os.path.abspath(__file__)))

# Product folder -> ctest labels whose tests cover it.
AREAS = OrderedDict([
    ("epsconvert", ["engine", "frame", "filter", "fuzz"]),
    ("plugin", ["filter", "frame", "fuzz", "ui"]),
    ("clientapp", ["store", "server", "machine", "fuzz"]),
    ("db", ["store", "machine", "server", "filter", "fuzz"]),
    ("utils", ["units", "machine", "fuzz"]),
    ("settings_core", ["units", "ui", "filter", "store", "host"]),
    ("settings_ui", ["units", "ui", "filter"]),
    ("sdk", ["frame", "units"]),
    ("host", ["host", "service"]),
    ("printing", ["ppd", "host", "service"]),
    ("posix", ["engine", "store", "machine", "host", "service"]),
    ("manager", ["manager"]),
])

# ---------------------------------------------------------------- tokens

TOKEN = re.compile(r'''
    (?P<comment>//[^\n]*|/\*.*?\*/)
  | (?P<string>"(?:\\.|[^"\\\n])*")
  | (?P<char>'(?:\\.|[^'\\\n])+')
  | (?P<number>\b(?:0[xX][0-9a-fA-F]+|\d+)(?:[uUlL]*)\b(?!\.))
  | (?P<ident>[A-Za-z_]\w*)
  | (?P<op>\+\+|--|->|<<=|>>=|<<|>>|<=|>=|==|!=|&&|\|\||::|[-+*/%<>=!&|^~?:;,.(){}\[\]])
  | (?P<space>\s+)
  | (?P<other>.)
''', re.S | re.X)


def tokenize(text):
    return [(m.lastgroup, m.group(), m.start()) for m in TOKEN.finditer(text)]


class Mutant:
    def __init__(self, path, offset, length, replacement, kind, text):
        self.path, self.offset, self.length = path, offset, length
        self.replacement, self.kind = replacement, kind
        line = text.count("\n", 0, offset) + 1
        self.line = line
        self.before = text[offset:offset + length]

    def describe(self):
        before = " ".join(self.before.split())
        after = " ".join(self.replacement.split())
        if len(before) > 60:
            before = before[:57] + "..."
        if len(after) > 60:
            after = after[:57] + "..."
        return f"{self.kind}: {before!r} -> {after!r}"

    def apply(self, text):
        return text[:self.offset] + self.replacement + text[self.offset + self.length:]


SWAPS = {
    "relational": {"<": "<=", "<=": "<", ">": ">=", ">=": ">"},
    "equality": {"==": "!=", "!=": "=="},
    "logical": {"&&": "||", "||": "&&"},
    "arithmetic": {"+": "-", "-": "+", "*": "/", "/": "*"},
}


def spaced(text, start, length):
    """Binary operators stand between blanks in the formatted code; template
    brackets, unary signs and pointers do not."""
    return (start > 0 and text[start - 1] == " " and
            start + length < len(text) and text[start + length] == " ")


def matching_paren(tokens, i):
    depth = 0
    for j in range(i, len(tokens)):
        if tokens[j][1] == "(":
            depth += 1
        elif tokens[j][1] == ")":
            depth -= 1
            if depth == 0:
                return j
    return None


def mutants_of(path, text):
    tokens = [t for t in tokenize(text)]
    code = [t for t in tokens if t[0] not in ("space", "comment")]
    out = []
    line_starts_preprocessor = set()
    for m in re.finditer(r"^[ \t]*#.*$", text, re.M):
        line_starts_preprocessor.add(text.count("\n", 0, m.start()))

    def in_directive(pos):
        return text.count("\n", 0, pos) in line_starts_preprocessor

    for idx, (kind, tok, pos) in enumerate(code):
        if in_directive(pos):
            continue
        if kind == "op":
            for name, table in SWAPS.items():
                if tok in table and spaced(text, pos, len(tok)):
                    out.append(Mutant(path, pos, len(tok), table[tok], name, text))
        elif kind == "number":
            digits = re.match(r"(0[xX][0-9a-fA-F]+|\d+)", tok).group(1)
            octal = len(digits) > 1 and digits[0] == "0" and digits[1] not in "xX"
            value = int(digits, 8) if octal else int(digits, 0)
            spell = ((lambda v: "0%o" % v) if octal else
                     (lambda v: hex(v)) if digits[:2] in ("0x", "0X") else str)
            suffix = tok[len(digits):]
            out.append(Mutant(path, pos, len(tok), spell(value + 1) + suffix, "constant", text))
            if value > 0:
                out.append(Mutant(path, pos, len(tok), spell(value - 1) + suffix, "constant",
                                  text))
        elif kind == "string" and len(tok) > 2:
            body = tok[1:-1]
            letters = [i for i, c in enumerate(body) if c.isalnum()]
            if letters:
                i = letters[len(letters) // 2]
                c = body[i]
                new = "x" if c != "x" else "y"
                if c.isdigit():
                    new = "7" if c != "7" else "8"
                out.append(Mutant(path, pos + 1 + i, 1, new, "text", text))
        elif kind == "ident" and tok in ("if", "while") and idx + 1 < len(code) \
                and code[idx + 1][1] == "(":
            close = matching_paren(code, idx + 1)
            if close is None:
                continue
            start = code[idx + 1][2] + 1
            end = code[close][2]
            cond = text[start:end]
            out.append(Mutant(path, start, end - start, f"!({cond})", "negate", text))
            # Top-level && operands: keep one side only.
            depth, parts, last = 0, [], start
            for k in range(idx + 2, close):
                t = code[k]
                if t[1] == "(":
                    depth += 1
                elif t[1] == ")":
                    depth -= 1
                elif t[1] == "&&" and depth == 0:
                    parts.append((last, t[2]))
                    last = t[2] + 2
            if parts:
                parts.append((last, end))
                for a, b in parts[:2]:
                    out.append(Mutant(path, start, end - start, text[a:b].strip(),
                                      "drop-operand", text))
        elif kind == "ident" and tok == "return":
            # return VALUE; with a literal value
            j = idx + 1
            if j + 1 < len(code) and code[j + 1][1] == ";":
                v = code[j][1]
                flip = {"true": "false", "false": "true", "0": "1", "1": "0",
                        "nullptr": None}
                if v in flip and flip[v] is not None:
                    out.append(Mutant(path, code[j][2], len(v), flip[v], "return", text))
    # Call statements alone on a line: remove them. Not in headers, where such
    # lines are mostly declarations.
    if path.endswith(".h"):
        return out
    for m in re.finditer(r"^([ \t]+)((?:[A-Za-z_][\w:]*(?:\.|->))*[A-Za-z_][\w:]*\([^;{}]*\));[ \t]*$",
                         text, re.M):
        stmt = m.group(2)
        head = stmt.split("(")[0]
        if head in ("if", "while", "for", "switch", "return", "sizeof", "static_assert") \
                or head.isupper():
            continue
        if stmt.count("(") != stmt.count(")"):
            continue
        if re.search(r"\(\s*(const\s+)?[A-Za-z_][\w:<>]*[\s*&]+[A-Za-z_]\w*\s*[,)=]", stmt):
            continue  # a declaration: "Type name(Type arg, ...)"
        out.append(Mutant(path, m.start(2), len(stmt) + 1, ";", "remove-call", text))
    return out


def changed_lines(rev, files):
    """Line numbers, in today's files, of the lines added or changed since
    rev: the '+' side of each hunk of a diff without context."""
    diff = subprocess.run(["git", "diff", "-U0", "--no-color", rev, "--", *files], cwd=ROOT,
                          check=True, capture_output=True, text=True,
                          errors="surrogateescape").stdout
    changed, path = defaultdict(set), None
    for line in diff.splitlines():
        if line.startswith("+++ "):
            path = line[6:] if line.startswith("+++ b/") else None
        elif line.startswith("@@") and path:
            m = re.match(r"@@ -\S+ \+(\d+)(?:,(\d+))? @@", line)
            start, count = int(m.group(1)), int(m.group(2) or 1)
            changed[path].update(range(start, start + count))
    return changed


def product_files(areas):
    files = subprocess.run(["git", "ls-files", "--", *areas], cwd=ROOT, check=True,
                           capture_output=True, text=True).stdout.split()
    return [f for f in files if f.endswith(".cpp") or f.endswith(".h")]


# ---------------------------------------------------------------- running

def run(cmd, cwd, timeout, env=None):
    """Runs cmd in its own process group; returns (status, seconds), status
    None on time-out."""
    start = time.time()
    proc = subprocess.Popen(cmd, cwd=cwd, stdout=subprocess.DEVNULL,
                            stderr=subprocess.DEVNULL, start_new_session=True, env=env)
    try:
        rc = proc.wait(timeout=timeout)
    except subprocess.TimeoutExpired:
        os.killpg(proc.pid, signal.SIGKILL)
        proc.wait()
        rc = None
    return rc, time.time() - start


def copy_tree(dest):
    files = subprocess.run(["git", "ls-files", "-z"], cwd=ROOT, check=True,
                           capture_output=True).stdout.split(b"\0")
    for f in files:
        if not f:
            continue
        f = f.decode()
        src = os.path.join(ROOT, f)
        if not os.path.isfile(src):
            continue
        dst = os.path.join(dest, f)
        os.makedirs(os.path.dirname(dst), exist_ok=True)
        shutil.copy2(src, dst)


def round_robin(by_area, areas, sample):
    """Takes each area in turn so that a cut sample still covers each one."""
    sampled = []
    queues = [list(by_area[a]) for a in areas if by_area[a]]
    while any(queues):
        for q in queues:
            if q:
                sampled.append(q.pop(0))
    return sampled[:sample] if sample else sampled


def listed_mutants(listing, areas):
    """The mutants of a list written by --list. Random sampling depends on
    every product file, so a sample is repeated from its list: each mutant is
    found again in today's file by its change, nearest the line it had."""
    found, texts = [], {}
    with open(listing, encoding="utf-8") as fh:
        entries = [l.rstrip("\n").split("\t", 1) for l in fh if "\t" in l]
    for place, change in entries:
        path, line = place.rsplit(":", 1)
        if path.split("/")[0] not in areas:
            continue
        if path not in texts:
            try:
                with open(os.path.join(ROOT, path), encoding="utf-8",
                          errors="surrogateescape") as fh:
                    texts[path] = mutants_of(path, fh.read())
            except FileNotFoundError:
                texts[path] = []
        same = [m for m in texts[path] if m.describe() == change]
        if not same:
            print(f"mutate: {place} {change}: no longer in the code", file=sys.stderr)
            continue
        found.append(min(same, key=lambda m: abs(m.line - int(line))))
    return found


def main():
    parser = argparse.ArgumentParser(description=__doc__.split("\n")[0])
    parser.add_argument("--seed", type=int, default=1)
    parser.add_argument("--per-file", type=int, default=3)
    parser.add_argument("--sample", type=int, default=0)
    parser.add_argument("--minutes", type=float, default=0)
    parser.add_argument("--area", action="append", choices=list(AREAS))
    parser.add_argument("--since", metavar="REV")
    parser.add_argument("--list", action="store_true")
    parser.add_argument("--keep", action="store_true")
    parser.add_argument("--results")
    parser.add_argument("--mutants", help="take exactly the mutants listed in this file "
                        "('path:line<TAB>change' lines, as --list prints them), to repeat "
                        "an earlier sample on a tree that has changed since; each is found "
                        "again by its change, nearest its line")
    args = parser.parse_args()

    areas = [a for a in (args.area or AREAS) if os.path.isdir(os.path.join(ROOT, a))]
    rng = random.Random(args.seed)
    by_area = defaultdict(list)
    files = sorted(product_files(areas))
    since = changed_lines(args.since, files) if args.since else None
    for f in files:
        if since is not None and f not in since:
            continue
        with open(os.path.join(ROOT, f), encoding="utf-8", errors="surrogateescape") as fh:
            text = fh.read()
        candidates = mutants_of(f, text)
        if since is not None:
            candidates = [m for m in candidates if m.line in since[f]]
        rng.shuffle(candidates)
        by_area[f.split("/")[0]].extend(candidates[:args.per_file])
    for a in by_area:
        rng.shuffle(by_area[a])
    if args.mutants:
        sampled = listed_mutants(args.mutants, areas)
    else:
        sampled = round_robin(by_area, areas, args.sample)

    if args.list:
        for m in sampled:
            print(f"{m.path}:{m.line}\t{m.describe()}")
        print(f"{len(sampled)} mutants (seed {args.seed})")
        return 0

    scratch = tempfile.mkdtemp(prefix="hf-mutate-")
    src = os.path.join(scratch, "src")
    build = os.path.join(scratch, "build")
    results = []
    try:
        copy_tree(src)
        # A test a mutant crashes or hangs is killed before it can remove its
        # scratch folders; they go with the harness's own.
        # Searchable by all, as /tmp is: a store test reads its folder as
        # the unprivileged user.
        os.chmod(scratch, 0o755)
        os.mkdir(os.path.join(scratch, "tmp"), 0o755)
        env = dict(os.environ, CCACHE_BASEDIR=scratch, CCACHE_NOHASHDIR="1",
                   TMPDIR=os.path.join(scratch, "tmp"))
        print(f"mutate: baseline build in {build}", flush=True)
        rc, _ = run(["cmake", "--preset", "default", "-S", src, "-B", build,
                     "-DHF_BUILD_BENCH=OFF"], src, 600, env)
        rc2, build_time = run(["cmake", "--build", build, "-j2"], src, 3600, env)
        if rc or rc2:
            print("mutate: the unmutated tree does not build", file=sys.stderr)
            return 2
        label_time = {}
        for area in areas:
            labels = "|".join(AREAS[area])
            rc, t = run(test_command(labels), build, 3600, env)
            if rc:
                print(f"mutate: the tests of {area} fail on the unmutated tree", file=sys.stderr)
                return 2
            label_time[area] = t
        deadline = time.time() + args.minutes * 60 if args.minutes else None
        for n, m in enumerate(sampled, 1):
            if deadline and time.time() > deadline:
                print(f"mutate: time is up after {n - 1} mutants")
                break
            area = m.path.split("/")[0]
            target = os.path.join(src, m.path)
            with open(target, encoding="utf-8", errors="surrogateescape") as fh:
                original = fh.read()
            with open(target, "w", encoding="utf-8", errors="surrogateescape") as fh:
                fh.write(m.apply(original))
            try:
                rc, _ = run(["cmake", "--build", build, "-j2"], src,
                            max(600, 3 * build_time), env)
                if rc != 0:
                    verdict = "no-compile"
                else:
                    limit = max(60, 3 * label_time[area])
                    rc, _ = run(test_command("|".join(AREAS[area])), build, limit, env)
                    verdict = "timed-out" if rc is None else ("killed" if rc else "survived")
            finally:
                with open(target, "w", encoding="utf-8", errors="surrogateescape") as fh:
                    fh.write(original)
            results.append((m, verdict))
            print(f"[{n}/{len(sampled)}] {verdict:10} {m.path}:{m.line} {m.describe()}",
                  flush=True)
        report(results, args)
    finally:
        if args.keep:
            print(f"mutate: scratch tree kept in {scratch}")
        else:
            shutil.rmtree(scratch, ignore_errors=True)
    return 0


def test_command(labels):
    # Whole labels only: "host" alone would also match "ghostscript".
    cmd = ["ctest", "-L", f"^({labels})$", "-j2", "--timeout", "300", "--stop-on-failure"]
    if shutil.which("xvfb-run"):
        cmd = ["xvfb-run", "-a", "-s", "-screen 0 1280x1024x24"] + cmd
    return cmd


def report(results, args):
    table = OrderedDict()
    for m, verdict in results:
        row = table.setdefault(m.path.split("/")[0], defaultdict(int))
        row[verdict] += 1
    print()
    print(f"{'area':12} {'mutants':>8} {'killed':>7} {'survived':>9} {'no-compile':>11} "
          f"{'timed-out':>10} {'score':>6}")
    total = defaultdict(int)
    for area, row in list(table.items()) + [("all", None)]:
        if row is None:
            row = total
        else:
            for k, v in row.items():
                total[k] += v
        counted = row["killed"] + row["survived"] + row["timed-out"]
        score = (row["killed"] + row["timed-out"]) / counted if counted else 0
        print(f"{area:12} {sum(row.values()):8} {row['killed']:7} {row['survived']:9} "
              f"{row['no-compile']:11} {row['timed-out']:10} {score:6.1%}")
    survivors = [m for m, v in results if v == "survived"]
    if survivors:
        print("\nsurvivors:")
        for m in survivors:
            print(f"  {m.path}:{m.line}  {m.describe()}")
    if args.results:
        with open(args.results, "w") as fh:
            fh.write("file\tline\tchange\tverdict\n")
            for m, verdict in results:
                fh.write(f"{m.path}\t{m.line}\t{m.describe()}\t{verdict}\n")


if __name__ == "__main__":
    sys.exit(main())
