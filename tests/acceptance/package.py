#!/usr/bin/env python3
"""Builds the Debian packages, installs them into an empty root, runs the programs from there, removes them.
package.py BUILD; ends with 77 (skipped) where dpkg or cpack are missing. Nothing outside a temporary
folder is touched, no network is asked.
"""
import gzip
import pathlib
import re
import shutil
import subprocess
import sys
import tempfile

BUILD = pathlib.Path(sys.argv[1]).resolve()
BY_HAND_D = 0.0997  # m, ATC-40 A: examples/first-steps/README.md, "Check it by hand"
faults = []


def run(*words, **more):
    done = subprocess.run([str(word) for word in words], capture_output=True, text=True, **more)
    expect(done.returncode == 0, f"{' '.join(map(str, words))}: {done.returncode}\n{done.stdout}{done.stderr}")
    return done.stdout


def expect(holds, words):
    if not holds:
        faults.append(words)


def needs(*tools):
    missing = [tool for tool in tools if not shutil.which(tool)]
    if missing:
        print("skipped:", *missing, "not installed")
        sys.exit(77)


def dpkg(root, *words):
    """dpkg on a root of its own, which has no libraries in its list: those of the machine are run."""
    run("dpkg", f"--root={root}", "--force-not-root,depends", "--log=/dev/null", *words)


def empty_root(folder):
    root = folder / "root"
    for name in ("info", "updates", "triggers"):
        (root / "var/lib/dpkg" / name).mkdir(parents=True)
    (root / "var/lib/dpkg/status").touch()
    return root


def check_fields(packages):
    for name, depends in (("qm-rps", ("libqt6gui6", "libsqlite3-0")), ("qm-rps-desktop", ("qm-rps (=", "libqt6widgets6"))):
        fields = run("dpkg-deb", "-f", packages[name])
        for library in depends:
            expect(library in fields, f"{name} does not depend on {library}")
        expect("Description: Pushover evaluation" in fields and "\n The " in fields and "Installed-Size" in fields, f"{name}: {fields}")


def check_files(root):
    for name in ("bin/qm-rps", "bin/qm-rps-desktop", "share/man/man1/qm-rps-hinge.1.gz",
                 "share/man/it/man1/qm-rps.1.gz", "share/man/man1/qm-rps-desktop.1.gz",
                 "share/bash-completion/completions/qm-rps", "share/zsh/vendor-completions/_qm-rps",
                 "share/applications/qm-rps-desktop.desktop", "share/mime/packages/qm-rps.xml",
                 "share/icons/hicolor/scalable/apps/qm-rps.svg", "share/qm-rps/docs/guide/start.md"):
        expect((root / "usr" / name).is_file(), f"no {name}")
    for package in ("qm-rps", "qm-rps-desktop"):
        for name in ("changelog.gz", "changelog.Debian.gz", "NOTICE"):
            expect((root / f"usr/share/doc/{package}" / name).is_file(), f"{package}: no {name}")
        text = (root / f"usr/share/doc/{package}/copyright").read_text()
        expect("All rights reserved until the owner chooses" in text, f"{package}: copyright")
    for tool, *words in (("desktop-file-validate", "applications/qm-rps-desktop.desktop"),
                         ("appstreamcli", "validate", "--no-net", "metainfo/qm-rps-desktop.metainfo.xml"),
                         ("xmllint", "--noout", "mime/packages/qm-rps.xml"),
                         ("man", "-l", "man/it/man1/qm-rps-ulf.1.gz")):
        if shutil.which(tool):
            said = run(tool, *words[:-1], root / "usr/share" / words[-1])
            expect("warning" not in said.lower(), said)
        else:
            print(f"not checked: {tool} is not installed")


def check_programs(root, folder, version):
    environment = {"PATH": f"{root}/usr/bin:/usr/bin:/bin", "HOME": str(folder),
                   "QT_QPA_PLATFORM": "offscreen", "XDG_RUNTIME_DIR": str(folder)}
    case = root / "usr/share/qm-rps/examples/first-steps/case.json"
    expect(run("qm-rps", "--version", env=environment).strip() == f"qm_rps {version}", "qm-rps --version")
    table = run("qm-rps", "evaluate", case, "--only", "PX ATC-40 A", env=environment)
    row = next(line for line in table.splitlines() if line.startswith("PX ATC-40 A")).split()
    expect(abs(float(row[6]) - BY_HAND_D) < 1e-4, f"D: {row}")
    run("qm-rps-desktop", "--start-only", case, env=environment)
    page = gzip.decompress((root / "usr/share/man/man1/qm-rps-desktop.1.gz").read_bytes()).decode().replace("\\", "")
    for option in re.findall(r"--[a-z][a-z-]+", run("qm-rps-desktop", "--help", env=environment)):
        expect(option in page, f"the manual page of the desktop does not tell {option}")


def main(folder):
    run("cpack", "--config", BUILD / "CPackConfig.cmake", "-B", folder / "made", cwd=folder)
    made = sorted((folder / "made").glob("*.deb"))
    packages = {path.name.split("_")[0]: path for path in made}
    expect(sorted(packages) == ["qm-rps", "qm-rps-desktop"], f"packages: {made}")
    if faults:
        return
    check_fields(packages)
    root = empty_root(folder)
    dpkg(root, "-i", *made)
    if not faults:
        check_files(root)
        check_programs(root, folder, packages["qm-rps"].name.split("_")[1].split("-")[0])
    dpkg(root, "--purge", "qm-rps-desktop", "qm-rps")
    left = [path for path in root.rglob("*") if "var" not in path.relative_to(root).parts[:1]]
    expect(not left, f"left behind: {left[:5]}")


needs("cpack", "dpkg", "dpkg-deb", "dpkg-shlibdeps", "file", "gzip")
with tempfile.TemporaryDirectory() as temporary:
    main(pathlib.Path(temporary))
print("\n".join(faults) or "packages: built, installed, run, removed, nothing left")
sys.exit(1 if faults else 0)
