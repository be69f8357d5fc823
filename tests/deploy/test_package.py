"""The Debian packages as an administrator gets them: what they hold is what
the README says, the module finds the simulated adapter library where the
packages put it, and the maintainer scripts never fail an install.

    test_package.py BUILD_DIR CIMHOST

Skipped (77) where dpkg-deb or cpack is missing.
"""

import os
import re
import shutil
import subprocess
import sys
import tempfile
import unittest

sys.dont_write_bytecode = True
ROOT = os.path.abspath(os.path.join(os.path.dirname(os.path.abspath(__file__)), "..", ".."))
BUILD = CIMHOST = None


def readme_packages():
    """Package name -> the files the README lists for it."""
    with open(os.path.join(ROOT, "README.md")) as f:
        text = f.read()
    m = re.search(r"^### What the packages hold\n(.*?)^#", text, re.S | re.M)
    if not m:
        raise AssertionError("README.md has no section 'What the packages hold'")
    packages = {}
    current = None
    for line in m.group(1).splitlines():
        line = line.strip()
        if line.endswith(".deb"):
            current = packages.setdefault(line.split("_")[0], [])
        elif line.startswith("/") and current is not None:
            current.append(line)
    return packages


class Package(unittest.TestCase):

    @classmethod
    def setUpClass(cls):
        cls.tmp = tempfile.mkdtemp(prefix="vspr_package_")
        p = subprocess.run(["cpack", "-G", "DEB", "--config",
                            os.path.join(BUILD, "CPackConfig.cmake"), "-B", cls.tmp],
                           capture_output=True, text=True, timeout=600)
        if p.returncode != 0:
            raise AssertionError("cpack failed:\n" + p.stdout + p.stderr)
        cls.debs = dict((f.split("_")[0], os.path.join(cls.tmp, f))
                        for f in os.listdir(cls.tmp) if f.endswith(".deb"))
        cls.root = os.path.join(cls.tmp, "root")
        for deb in cls.debs.values():
            subprocess.run(["dpkg-deb", "-x", deb, cls.root], check=True)

    @classmethod
    def tearDownClass(cls):
        shutil.rmtree(cls.tmp, ignore_errors=True)

    def test_packages_hold_what_the_readme_says(self):
        listed = readme_packages()
        self.assertEqual(sorted(listed), sorted(self.debs))
        for name, deb in self.debs.items():
            out = subprocess.run(["dpkg-deb", "-c", deb], capture_output=True, text=True,
                                 check=True).stdout
            files = sorted(line.split()[-1].lstrip(".") for line in out.splitlines()
                           if not line.startswith("d"))
            self.assertEqual(sorted(listed[name]), files, name)

    def test_module_finds_the_simulator_beside_it(self):
        # As a server loads it: by path, with no library path of its own.
        env = dict(os.environ, LD_LIBRARY_PATH="", HOME=self.tmp)
        module = os.path.join(self.root, "usr/lib/cmpi/libvsprprovider_Module.so")
        reg = os.path.join(self.root, "usr/share/vsprprovider/vsprprovider.reg")
        p = subprocess.run([CIMHOST, "--module", module, "--reg", reg,
                            "ein", "root/vespera:VESPERA_FCPort"],
                           env=env, capture_output=True, text=True, timeout=120)
        self.assertEqual(0, p.returncode, p.stderr)
        self.assertIn("VESPERA_FCPort.", p.stdout)

    def test_maintainer_scripts_never_fail_the_install(self):
        control = os.path.join(self.tmp, "control")
        subprocess.run(["dpkg-deb", "-e", self.debs["vsprprovider"], control], check=True)
        # An SFCB that isn't running: registration is put off, with a word.
        stubs = os.path.join(self.tmp, "stubs")
        os.makedirs(stubs, exist_ok=True)
        for tool in ("sfcbstage", "sfcbrepos"):
            with open(os.path.join(stubs, tool), "w") as f:
                f.write("#!/bin/sh\nexit 0\n")
            os.chmod(os.path.join(stubs, tool), 0o755)
        env = dict(os.environ, PATH=":".join([stubs, os.path.join(self.root, "usr/bin"),
                                              "/usr/bin", "/bin"]),
                   VSPR_STATE_DIR=os.path.join(self.tmp, "state"),
                   VSPR_SFCB_DAEMON="nosuchsfcbd")
        p = subprocess.run(["sh", os.path.join(control, "postinst"), "configure"],
                           env=env, capture_output=True, text=True, timeout=60)
        self.assertEqual(0, p.returncode, p.stderr)
        self.assertIn("vspr-register sfcb", p.stderr)
        self.assertIn("isn't running", p.stderr)
        for script, arg in (("prerm", "remove"), ("postrm", "remove")):
            p = subprocess.run(["sh", os.path.join(control, script), arg],
                               env=env, capture_output=True, text=True, timeout=60)
            self.assertEqual(0, p.returncode, script + ": " + p.stderr)


if __name__ == "__main__":
    if not shutil.which("dpkg-deb") or not shutil.which("cpack"):
        print("dpkg-deb or cpack not found: skipped")
        sys.exit(77)
    BUILD, CIMHOST = sys.argv.pop(1), sys.argv.pop(1)
    unittest.main()
