#!/usr/bin/env python3
"""The help in other forms says what --help says: manual pages in both languages, completion in a real
bash, and a zsh that reads its function. helpforms.py PROGRAM; what is missing on this machine is named.
"""
import pathlib
import re
import shutil
import subprocess
import sys
import tempfile

PROGRAM = str(pathlib.Path(sys.argv[1]).resolve())
ROOT = pathlib.Path(__file__).resolve().parents[2]
faults = []


def run(*words, code=0, cwd=ROOT):
    done = subprocess.run(words, capture_output=True, text=True, cwd=cwd)
    expect(done.returncode == code, f"{' '.join(words)}: exit code {done.returncode}\n{done.stderr}")
    return done


def expect(holds, words):
    if not holds:
        faults.append(words)


def have(tool):
    if not shutil.which(tool):
        print(f"not checked: {tool} is not installed")
    return shutil.which(tool)


def commands(above=()):
    """Every command as --help lists them, with its help; the program is ()."""
    text = run(PROGRAM, *above, "--help").stdout
    yield above, text
    listed = re.search(r"\nSubcommands:\n((?:  .*\n)+)", text)
    for name in re.findall(r"(?m)^  (\S+)", listed[1]) if listed else []:
        yield from commands((*above, name))


def plain(page):
    """What a reader sees of a page, in one line."""
    text = run("groff", "-Tutf8", "-man", "-P-c", "-P-b", "-P-u", str(page)).stdout
    return re.sub(r"\s+", " ", text.replace("\u2010\n", "").replace("\u2212", "-"))


def check_pages(folder):
    known = list(commands())
    expect(len(known) > 40, "few commands")
    for language, heads in (("en", ("NAME", "EXIT STATUS")), ("it", ("NOME", "STATO D'USCITA"))):
        pages = folder / language
        pages.mkdir()
        run(PROGRAM, "--lang", language, "help", "--man", str(pages))
        run(PROGRAM, "--lang", language, "help", "--man", str(pages), code=4)  # never over others
        if not have("groff"):
            continue
        for page in sorted(pages.iterdir()):
            said = run("groff", "-Tutf8", "-man", "-ww", "-z", str(page)).stderr
            expect(not said, f"{page.name} {language}: {said}")
        texts = {page.name: plain(page) for page in pages.iterdir()}
        for words, text in known:
            page = texts.get("-".join(("qm-rps", *words[:1])) + ".1", "")
            for head in heads:
                expect(head in page, f"{words} {language}: no {head}")
            for option in re.findall(r"(?m)^  (?:-\w,)?(--?[a-z][\w-]*)", text):
                expect(re.search(rf"(?<![\w-]){option}(?![\w-])", page), f"{words} {language}: no {option}")


# What is typed, the last word being completed, and what bash proposes (some of it, where "..." ends it).
TYPED = [
    ("ev", "evaluate"),
    ("--lang ", "en it"),
    ("--lang=i", "it"),
    ("--lang it hinge gen", "generate generated"),
    ("hinge generate --code EN", "EN1998-3"),
    ("section check --code EN A", "ACI AISC"),
    ("section curvature --axial 0 -5 --law ", "aci eurocode"),
    ("evaluate --only push --plot-d", "--plot-demand"),
    ("evaluate examples/first-steps/", "examples/first-steps/case.json"),
    ("import examples/first-steps/case.json docs/pic", "docs/pictures"),
    ("judge x.json --plot docs/pictures/hinge", "docs/pictures/hinge-fema.png"),
    ("ulf solve x.json --item ", ""),
    ("verify examples/veri", "examples/verification"),
    ("push examples/first", "examples/first-steps"),
    ("push set", "setup"),
]
BASH = r"""
source "$1"; shift
COMP_WORDS=("$@"); COMP_CWORD=$(($# - 1)); _qm_rps; printf '%s\n' "${COMPREPLY[@]}"
"""


def check_completion(folder):
    script = folder / "qm-rps.bash"
    script.write_text(run(PROGRAM, "help", "--completion", "bash").stdout)
    for typed, proposed in TYPED:
        words = re.sub("=", " = ", typed).split(" ")  # as bash breaks the line
        got = run("bash", "-c", BASH, "bash", str(script), "qm-rps", *words).stdout.split()
        expect(sorted(got) == sorted(proposed.split()), f"completion of '{typed}': {got}")
    function = folder / "_qm-rps"
    function.write_text(run(PROGRAM, "help", "--completion", "zsh").stdout)
    if have("zsh"):
        run("zsh", "-n", str(function))
    named = re.findall(r"(?m)^(_qm_rps\w*)\(\)", function.read_text())
    expect(len(named) == len(list(commands())), "zsh: a function for each command")


with tempfile.TemporaryDirectory() as temporary:
    check_pages(pathlib.Path(temporary))
    check_completion(pathlib.Path(temporary))
expect(run(PROGRAM, "help", "ulf", "solve").stdout == run(PROGRAM, "ulf", "solve", "--help").stdout,
       "help ulf solve is not its --help")
run(PROGRAM, "help", "ulf", "nothing", code=2)
print("\n".join(faults) or "manual pages and completion say what --help says")
sys.exit(1 if faults else 0)
