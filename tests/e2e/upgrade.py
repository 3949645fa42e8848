"""See upgrade.sh. Arguments: the repository, the working folder, and whether the small disk is mounted."""
import os
import subprocess
import sys

from prefix import Prefix, differences

ROOT, WORK, MOUNTED = sys.argv[1:4]
prefix = Prefix(ROOT, WORK, "one")
results = []


def check(name, faults):
    results.append(bool(faults))
    if faults:
        print(f"FAILED upgrade, {name}:", *faults[:20], sep="\n  ")


def same(what, found, wanted):
    return [] if found == wanted else [f"{what} is {found!r}, not {wanted!r}"]


def install(version, folder):
    """The exit code, and what was shown."""
    return prefix.run(prefix.headless, "install", prefix.win(f"{WORK}/{version}.exe"), folder,
                      prefix.win(f"{ROOT}/src/installer/scripts") + "\\")


def uninstall(folder):
    return prefix.run(folder + "\\UnInstall.exe", "/VERYSILENT", folder)[0]


def write(path, text):
    with open(path, "w", encoding="ascii") as file:
        file.write(text)


def files(folder):
    return sorted(os.path.relpath(os.path.join(where, name), folder) for where, _, names in os.walk(folder) for name in names)


def upgrade():
    where, folder = prefix.drive + "/Tavola/Plumo", "C:\\Tavola\\Plumo"
    before = prefix.state()
    faults = same("the first installation", install("first", folder)[0], 0)
    write(f"{where}/Old/stale, edited.txt", "the user's\n")
    os.utime(f"{where}/Old/stale, touched.txt", (1e9, 1e9))
    os.makedirs(f"{where}/Mine")
    write(f"{where}/Mine/added by the user.txt", "the user's\n")
    faults += same("the second installation", install("second", folder)[0], 0)
    records = ["Installed.lst", "Uninstall.log", "config.ini"]
    wanted = sorted([name for name in files(f"{WORK}/second") if name != "UnInstall01.exe"] + records +
                    ["Old/stale, edited.txt", "Mine/added by the user.txt"])
    faults += same("what is installed", files(where), wanted)
    faults += same("the changed file", open(f"{where}/changed.txt", encoding="ascii").read(), "changed in second\n")
    faults += ["the empty folder stays"] if os.path.exists(f"{where}/Old/Deep") else []
    write(f"{where}/edited.txt", "EDITED\n")
    check("a second version over a first", faults)

    faults = same("the exit code", uninstall(folder), 0)
    kept = ["", "/Mine", "/Mine/added by the user.txt", "/Old", "/Old/stale, edited.txt", "/edited.txt"]
    kept = ["left: /drive_c/Tavola"] + [f"left: /drive_c/Tavola/Plumo{name}" for name in kept]
    faults += same("what is left", differences(before, prefix.state()), kept)
    check("removal leaves what the user made", faults)
    subprocess.run(["rm", "-r", f"{prefix.drive}/Tavola"], check=True)

    # Whoever installs at once after removing must not lose the new installation to the old one's second step.
    faults = []
    for _ in range(3):
        faults += same("the installation", install("first", folder)[0], 0)
        faults += same("the exit code", uninstall(folder), 0)
        faults += ["something is left when it has ended"] if os.path.exists(where) else []
    faults += same("installing at once again", install("first", folder)[0], 0)
    prefix.settle()  # the old one's second step has ended
    faults += same("the list", os.path.exists(f"{where}/Installed.lst"), True)
    uninstall(folder)
    check("the exit code comes when all is gone", faults + differences(before, prefix.state()))


def full_disk():
    os.symlink(f"{WORK}/disk", f"{prefix.path}/dosdevices/f:")
    before, folder = prefix.state(), "F:\\Plumo"
    code, shown = install("large", folder)
    faults = same("the exit code", code, 1)
    faults += ["the user is not told: " + shown] if "Some files could not be installed: |  | zeros" not in shown else []
    listed = open(f"{WORK}/disk/Plumo/Installed.lst", encoding="cp1250").read() if os.path.exists(f"{WORK}/disk/Plumo/Installed.lst") else ""
    faults += [f"not listed: {name}" for name in files(f"{WORK}/disk/Plumo") if name not in listed + "Installed.lst"]
    subprocess.run(["mount", "-o", "remount,size=40m", f"{WORK}/disk"], check=True)
    code, shown = install("large", folder)
    faults += same("the second time", (code, 'message "Error' in shown), (0, False))
    faults += same("the exit code of removal", uninstall(folder), 0)
    faults += same("left on the disk", os.listdir(f"{WORK}/disk"), [])
    check("a full disk", faults + differences(before, prefix.state()))
    subprocess.run(["mount", "-o", "remount,size=4m", f"{WORK}/disk"], check=True)
    code = install("large", folder)[0]
    faults = same("removal of half an installation", prefix.run(prefix.win(f"{WORK}/large/UnInstall.exe"), "/S", folder)[0], 0)
    faults += same("left on the disk", os.listdir(f"{WORK}/disk"), [])
    check("a full disk, and removal at once", faults + differences(before, prefix.state()))


prefix.run(prefix.headless)
upgrade()
if MOUNTED:
    full_disk()
else:
    print("SKIPPED upgrade, a full disk: no small disk can be mounted here")
prefix.stop()
print(f"upgrade: {results.count(False)} passed, {results.count(True)} failed, {0 if MOUNTED else 2} skipped")
sys.exit(any(results))
