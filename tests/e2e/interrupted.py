"""See interrupted.sh. Arguments: the repository, the working folder with Setup.exe and the prefixes, the moments."""
import os
import select
import shutil
import signal
import subprocess
import sys
import threading
import time

from prefix import Prefix, differences

DESTINATION = "C:\\Programi\\Plumo"


class Test:
    def __init__(self, prefix):
        self.prefix = prefix
        self.product = f"{prefix.work}/product"
        self.scripts = prefix.win(f"{prefix.root}/src/installer/scripts") + "\\"
        self.folder = f"{prefix.drive}/Programi/Plumo"
        self.setup = prefix.win(f"{prefix.work}/Setup.exe")

    def prepare(self):
        self.prefix.run(self.prefix.headless)  # the prefix is up
        if self.prefix.name == "two":  # here the folder is the user's, and holds something
            os.makedirs(f"{self.folder}/Help")
            for name in "notes.txt", "Help/own.txt":
                with open(f"{self.folder}/{name}", "w", encoding="ascii") as file:
                    file.write("the user's\n")
        self.before = self.prefix.state()

    def command(self):
        return [self.prefix.headless, "install", self.setup, DESTINATION, self.scripts]

    def install(self, stop_at=None, power=False):
        """Runs setup; with stop_at kills it once it has made so many system calls that write. Returns the calls made."""
        process = self.prefix.start(*self.command(), stdout=subprocess.PIPE)
        first, calls = None, 0
        while process.poll() is None:
            if first is None and select.select([process.stdout], [], [], 0)[0]:
                first = self.write_calls(process)
            calls = max(calls, self.write_calls(process) - first) if first is not None else 0
            if stop_at is not None and calls >= stop_at:
                if power:
                    self.prefix.cut_power()
                os.kill(process.pid, signal.SIGKILL)
                break
        process.stdout.read()
        self.killed = process.wait() < 0
        self.code = process.returncode
        return calls

    @staticmethod
    def write_calls(process):
        try:
            with open(f"/proc/{process.pid}/io", encoding="ascii") as file:
                return int(file.read().split("syscw: ")[1].split()[0])
        except (OSError, IndexError):
            return 0

    def uninstall(self, program):
        return self.prefix.run(program, "/S", DESTINATION)[0]

    def age_short_leftovers(self):
        """A temporary file too short to be known for what it is goes only when it is old: the next start is later."""
        for path in self.prefix.temp_files():
            if os.path.basename(path).startswith("@") and os.path.getsize(path) < 4200:
                os.utime(path, (time.time() - 3600, time.time() - 3600))

    def missing(self):
        """What of the product is not installed as it should be."""
        bad = []
        for folder, _, files in os.walk(self.product):
            for name in files:
                path = os.path.join(folder, name)
                there = self.folder + path[len(self.product):]
                if name == "UnInstall01.exe":
                    there = f"{self.prefix.drive}/windows/{name}"
                same = os.path.exists(there) and open(path, "rb").read() == open(there, "rb").read()
                if not same:
                    bad.append(f"not installed: {path[len(self.product):]}")
        return bad

    def cycle(self, stop_at, power, at_once):
        """One moment; the faults found."""
        faults = []
        if power:
            self.prefix.stop()
        self.install(stop_at, power)
        self.age_short_leftovers()
        known = os.path.exists(f"{self.folder}/Installed.lst")
        if at_once and known:
            code = self.uninstall(self.prefix.win(f"{self.product}/UnInstall.exe"))
        else:
            self.install()
            faults += [f"setup again: {self.code}"] if self.code != 0 else []
            faults += self.missing()
            code = self.uninstall(DESTINATION + "\\UnInstall.exe")
        faults += [f"uninstall: {code}"] if code != 0 else []
        return faults + differences(self.before, self.prefix.state())

    def renew(self):
        """After a fault: a clean prefix for the next moment."""
        self.prefix.stop()
        shutil.rmtree(self.prefix.path)
        subprocess.run(["cp", "-a", f"{self.prefix.root}/build/wine-template/prefix", self.prefix.path], check=True)
        self.prepare()


def work(test, moments, results):
    test.prepare()
    all_calls = test.install()
    test.uninstall(DESTINATION + "\\UnInstall.exe")
    faults = differences(test.before, test.prefix.state()) if all_calls else ["setup does not install"]
    results.append((f"{test.prefix.name}: undisturbed, {all_calls} writing calls", faults))
    for i, count in moments if all_calls else []:
        stop_at = all_calls * (i + 1) // (count + 1)
        power, at_once = i % 6 in (2, 3), i % 4 in (1, 2)  # both, either and neither among the first six
        faults = test.cycle(stop_at, power, at_once)
        name = f"{test.prefix.name}: {'power cut' if power else 'killed'} at {stop_at} of {all_calls}"
        results.append((name + (", uninstalled at once" if at_once else ", installed again"), faults))
        if faults:
            test.renew()
    test.prefix.stop()


def main():
    root, folder, count = sys.argv[1], sys.argv[2], int(sys.argv[3])
    tests = [Test(Prefix(root, folder, name)) for name in ("one", "two")]
    results = []
    started = time.time()
    threads = [threading.Thread(target=work, args=(test, [(i, count) for i in range(n, count, 2)], results))
               for n, test in enumerate(tests)]
    for thread in threads:
        thread.start()
    for thread in threads:
        thread.join()
    failed = [(name, faults) for name, faults in results if faults]
    for name, faults in failed:
        print(f"FAILED interrupted, {name}:", *faults[:20], sep="\n  ")
    lost = count + len(tests) - len(results)  # a thread that did not come to its end
    print(f"{time.time() - started:.0f} s for {count} moments")
    print(f"interrupted: {len(results) - len(failed)} passed, {len(failed) + lost} failed, 0 skipped")
    return 1 if failed or lost else 0


sys.exit(main())
