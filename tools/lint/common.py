"""What the checkers share: the list of files, running commands, and the OK or FAIL at the end."""

import json
import subprocess
import sys
import threading
from concurrent.futures import ThreadPoolExecutor
from pathlib import Path

ROOT = Path(__file__).resolve().parents[2]


def files(*patterns):
    """Files that git tracks or would track, as paths relative to the project."""
    command = ["git", "ls-files", "-co", "--exclude-standard", "--", *patterns]
    names = subprocess.run(command, cwd=ROOT, check=True, capture_output=True, text=True).stdout.split("\n")
    return sorted(Path(name) for name in names if name and (ROOT / name).is_file())


def text(path):
    return (ROOT / path).read_text(encoding="utf-8", errors="replace")


def run(*command, **options):
    return subprocess.run([str(c) for c in command], cwd=ROOT, capture_output=True, text=True, **options)


def in_parallel(function, items):
    """The results of function over items, on two threads, in order."""
    with ThreadPoolExecutor(max_workers=2) as pool:
        return list(pool.map(function, items))


class CleanFiles:
    """The state in which each file was clean, kept in a JSON file from run to run, also of one that is broken off."""

    def __init__(self, path):
        self.path = path
        self.known = json.loads(path.read_text()) if path.exists() and "--all" not in sys.argv else {}
        self.lock = threading.Lock()

    def note(self, name, state):
        with self.lock:
            self.known[name] = state
            self.path.parent.mkdir(parents=True, exist_ok=True)
            self.path.write_text(json.dumps(self.known))


def finish(name, problems, checked):
    for problem in problems:
        print(problem)
    print(f"{'FAIL' if problems else 'OK'}: {name}, {checked} checked, {len(problems)} problems")
    sys.exit(1 if problems else 0)
