#!/usr/bin/env python3
"""Ill-treats libraries: kills the process that edits one, again and again, and lets two machines edit at once.

  library_storm.py --worker PROGRAM --kills 1000          after each kill the store opens and holds every change that is
                                                          older than half a second
  library_storm.py --worker PROGRAM --storms 3 --seconds 60   two processes with one sync folder end equal, and nothing
                                                          that either of them had is missing from library and backups
"""
import argparse
import pathlib
import random
import signal
import subprocess
import sys
import tempfile
import time

DURABLE_AFTER = 0.5  # seconds


def output(worker, *arguments):
    result = subprocess.run([worker, *map(str, arguments)], capture_output=True, text=True, timeout=60)
    if result.returncode != 0 or "problem:" in result.stderr:
        raise SystemExit(f"{arguments}: {result.stderr.strip()}")
    return result.stdout.split()


def log_entries(log):
    """(moment, version, abbreviations), the last line left out when it was cut short."""
    lines = log.read_text().split("\n")[:-1] if log.exists() else []
    fields = [line.split() for line in lines]
    return [(float(each[0]), each[1], each[2:]) for each in fields]


def check_after_kill(worker, store, log, killed_at):
    version, *abbreviations = output(worker, "show", store)
    entries = log_entries(log)
    settled = [i for i, entry in enumerate(entries) if entry[0] <= killed_at - DURABLE_AFTER]
    found = [i for i, entry in enumerate(entries) if entry[1] == version]
    if not found:
        # Written in the moment between the change and its line in the log.
        return "later than the log"
    if settled and found[-1] < settled[-1]:
        raise SystemExit(f"lost: the store holds change {found[-1]}, {settled[-1]} was older than half a second")
    if sorted(entries[found[-1]][2]) != sorted(abbreviations):
        raise SystemExit(f"version {version} holds other snippets than it had")
    return f"{len(entries) - 1 - found[-1]} changes behind"


def kill_again_and_again(worker, kills, seed):
    random.seed(seed)
    for number in range(kills):
        if number % 25 == 0:
            folder = pathlib.Path(tempfile.mkdtemp(prefix="plume-storm-"))
        log = folder / f"log-{number}"
        process = subprocess.Popen([worker, "edit", str(folder / "store"), str(log), str(seed + number)],
                                   stderr=subprocess.DEVNULL)
        time.sleep(random.choice([0.05, 0.3, 1.2]) * (0.5 + random.random()))
        killed_at = time.time()
        process.send_signal(signal.SIGKILL)
        if process.wait() != -signal.SIGKILL:
            raise SystemExit(f"the process ended by itself: {process.returncode}")
        what = check_after_kill(worker, folder / "store", log, killed_at)
        if number % 50 == 49:
            print(f"{number + 1} kills; the last one: {what}", flush=True)
        if number % 25 == 24 or number == kills - 1:
            subprocess.run(["rm", "-rf", str(folder)], check=True)


def storm(worker, seconds, seed):
    folder = pathlib.Path(tempfile.mkdtemp(prefix="plume-storm-"))
    shared = folder / "shared"
    shared.mkdir()
    machines = [folder / "one", folder / "two"]
    errors = [open(folder / f"errors-{machine.name}", "w+") for machine in machines]
    processes = [
        subprocess.Popen([worker, "edit", str(machine), str(folder / f"log-{machine.name}"), str(seed + i),
                          str(shared), str(seconds)], stderr=errors[i])
        for i, machine in enumerate(machines)]
    for process in processes:
        if process.wait(seconds + 60) != 0:
            raise SystemExit(f"a machine failed: {process.returncode}")
    ends = [output(worker, "show", machine) for machine in machines]
    everything = set(ends[0][1:]) | set(ends[1][1:])
    backups = [path for machine in machines for path in (machine / "Backups").glob("*.plume")]
    for path in backups:
        everything |= set(output(worker, "read", path))
    had = {each for machine in machines for entry in log_entries(folder / f"log-{machine.name}") for each in entry[2]}
    downloads = sum(open(error.name).read().count("replaced by another") for error in errors)
    print(f"{len(had)} snippets were made, {len(ends[0]) - 1} are in the library, {len(backups)} backups, "
          f"{downloads} downloads over unsent changes", flush=True)
    if ends[0] != ends[1]:
        raise SystemExit(f"the machines end differently: {ends[0][0]} and {ends[1][0]}")
    if had - everything:
        raise SystemExit(f"{len(had - everything)} snippets are nowhere, such as {sorted(had - everything)[:3]}; "
                         f"see {folder}")
    subprocess.run(["rm", "-rf", str(folder)], check=True)


def main():
    parser = argparse.ArgumentParser(description=__doc__, formatter_class=argparse.RawDescriptionHelpFormatter)
    parser.add_argument("--worker", required=True)
    parser.add_argument("--kills", type=int, default=0)
    parser.add_argument("--storms", type=int, default=0)
    parser.add_argument("--seconds", type=float, default=60)
    parser.add_argument("--seed", type=int, default=int(time.time()) % 100000)
    arguments = parser.parse_args()
    print(f"seed {arguments.seed}", flush=True)
    kill_again_and_again(arguments.worker, arguments.kills, arguments.seed)
    for number in range(arguments.storms):
        storm(arguments.worker, arguments.seconds, arguments.seed + 10 * number)
    return 0


if __name__ == "__main__":
    sys.exit(main())
