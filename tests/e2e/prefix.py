"""A Wine prefix for tests that change it often: programs run in it, and its whole state taken and compared.

  prefix.py ROOT WORK NAME save FILE       keeps the state of the prefix WORK/NAME
  prefix.py ROOT WORK NAME compare FILE    tells what has become different since; exit code 0 when nothing has
"""
import os
import pickle
import re
import signal
import stat
import subprocess
import sys
import time


# Wine writes what it finds of the screen whenever it starts; its debugger comes when a program loses its server.
NOISE = re.compile(r"\[(System\\\\CurrentControlSet\\\\Control\\\\Class\\\\\{4D36E96[8E]-|Software\\\\Wine\\\\WineDbg\])",
                   re.IGNORECASE)


class Prefix:
    def __init__(self, root, work, name):
        self.root, self.work, self.name = root, work, name
        self.path = f"{work}/{name}"
        self.drive = f"{self.path}/drive_c"
        self.env = dict(os.environ, WINEPREFIX=self.path)
        self.headless = f"{root}/build/windows/tests/e2e/headless/headless.exe"

    @staticmethod
    def win(path):
        return "Z:" + os.path.realpath(path).replace("/", "\\")

    def start(self, *command, **options):
        return subprocess.Popen(["wine", *command], env=self.env, cwd=self.work, stderr=subprocess.DEVNULL, **options)

    def run(self, *command):
        """The exit code, and what the program printed."""
        process = self.start(*command, stdout=subprocess.PIPE)
        output = process.communicate(timeout=240)[0]
        return process.returncode, output.decode("cp1250", "replace").replace("\r\n", "\n")

    def server(self):
        """The process of this prefix's Wine server."""
        info = os.stat(self.path)
        folder = f"/server-{info.st_dev:x}-{info.st_ino:x}"
        for pid in filter(str.isdigit, os.listdir("/proc")):
            try:
                if os.readlink(f"/proc/{pid}/cwd").endswith(folder) and "wineserver" in open(f"/proc/{pid}/comm").read():
                    return int(pid)
            except OSError:
                continue
        return None

    def stop(self):
        """Ends everything in an orderly way: the registry is on the disk afterwards."""
        for option in "-k", "-w":
            subprocess.run(["wineserver", option], env=self.env, stderr=subprocess.DEVNULL, check=False)

    def cut_power(self):
        """The server goes at once, with every process and with what it has not written to the disk."""
        server = self.server()
        if not server:
            raise RuntimeError("the Wine server is not found")
        os.kill(server, signal.SIGKILL)
        while os.path.exists(f"/proc/{server}"):
            time.sleep(0.01)

    def temp_files(self):
        folders = [f"{self.drive}/windows/temp"] + [f"{self.drive}/users/{u}/Temp" for u in os.listdir(f"{self.drive}/users")]
        return [f"{folder}/{name}" for folder in folders if os.path.isdir(folder) for name in os.listdir(folder)]

    def settle(self):
        """The uninstaller's copy deletes itself a moment after the uninstaller has ended."""
        for _ in range(1200):
            if not any(re.search(r"/uni[^/]*\.tmp$", path) for path in self.temp_files()):
                return
            time.sleep(0.05)

    def state(self):
        """Every file with its size and time, every folder, every value of the registry."""
        self.settle()
        state = {}
        for folder, folders, files in os.walk(self.drive):
            for name in folders + files:
                path = os.path.join(folder, name)
                info = os.lstat(path)
                whole = stat.S_ISREG(info.st_mode)
                state[path[len(self.path):]] = (info.st_size, info.st_mtime_ns, info.st_mode) if whole else info.st_mode
        dumps = [f"{self.work}/{self.name}.{root}" for root in ("machine", "user")]
        code, output = self.run(self.headless, "registry", *map(self.win, dumps))
        if code != 0:
            raise RuntimeError("the registry cannot be saved: " + output)
        for dump in dumps:
            key, noise = "", None
            with open(dump, encoding="utf-8", errors="replace") as file:
                for line in file.read().split("\n"):
                    if line.startswith("["):
                        key = line[:line.rindex("]") + 1]
                        noise = NOISE.match(key)
                        if not noise:
                            state[dump[-7:] + key] = ""
                    elif line and not line.startswith("#time") and not noise:
                        state[dump[-7:] + key] = state.get(dump[-7:] + key, "") + line
            os.remove(dump)
        return state


def differences(before, after):
    lines = [f"left: {name}" for name in sorted(after.keys() - before.keys())]
    lines += [f"gone: {name}" for name in sorted(before.keys() - after.keys())]
    lines += [f"changed: {name}: {before[name]} -> {after[name]}"[:400]
              for name in sorted(before.keys() & after.keys()) if before[name] != after[name]]
    return lines


def main():
    root, work, name, verb, path = sys.argv[1:]
    state = Prefix(root, work, name).state()
    if verb == "save":
        with open(path, "wb") as file:
            pickle.dump(state, file)
        return 0
    with open(path, "rb") as file:
        lines = differences(pickle.load(file), state)
    for line in lines or [f"no difference in {len(state)} files, folders and registry keys"]:
        print("  " + line)
    return 1 if lines else 0


if __name__ == "__main__":
    sys.exit(main())
