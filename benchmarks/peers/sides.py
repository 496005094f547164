"""The programs of both sides: what they need, how they are built and run."""
import os
import shutil
import subprocess
import sys
from pathlib import Path

ROOT = Path(__file__).resolve().parents[2]
SOURCES = Path(__file__).resolve().parent / "emf"
CLASSES = ROOT / "build" / "peers" / "classes"
PACKAGES = ["openjdk-17-jdk-headless", "libeclipse-emf-ecore-java", "libeclipse-emf-ecore-xmi-java",
            "libeclipse-emf-ecore-change-java"]
JARS = [f"/usr/share/java/{name}.jar" for name in (
    "eclipse-emf-common", "eclipse-emf-ecore", "eclipse-emf-ecore-xmi", "eclipse-emf-ecore-change",
    "equinox-common", "osgi.core")]
# Memory enough that the collector hardly ever has to look at all objects.
JAVA = ["java", "-XX:+UseSerialGC", "-Xms6g", "-Xmx12g"]
OURS = ROOT / "build" / "release" / "benchmarks" / "peers" / "books_of_tarnkiln"


def run(command, **options):
    return subprocess.run(command, check=True, **options)


def install_peer():
    if shutil.which("javac") and all(Path(jar).exists() for jar in JARS):
        return
    as_root = [] if os.geteuid() == 0 else ["sudo"]
    run(as_root + ["apt-get", "install", "--yes", "--quiet", "--no-install-recommends",
                   "--no-remove"] + PACKAGES, stdout=sys.stderr)


def build():
    """Builds both sides. Returns for each the command, to which a size and names are added."""
    CLASSES.mkdir(parents=True, exist_ok=True)
    run(["javac", "-d", CLASSES, "-cp", ":".join(JARS)] + sorted(SOURCES.glob("*.java")))
    run(["cmake", "--preset", "release"], cwd=ROOT, stdout=sys.stderr)
    run(["cmake", "--build", "--preset", "release", "--target", OURS.name], cwd=ROOT,
        stdout=sys.stderr)
    return {"ours": [OURS],
            "theirs": JAVA + ["-cp", ":".join(JARS + [str(CLASSES)]), "Main"]}


def measure(command, size, workloads):
    """The lines that one process prints about the workloads of these names."""
    return run(command + [str(size)] + workloads, stdout=subprocess.PIPE,
               text=True).stdout.splitlines()
