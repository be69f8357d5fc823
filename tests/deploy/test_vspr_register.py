"""vspr-register against stand-ins of the servers' tools.

The stand-ins on PATH record how they were called and keep what a server
would: SFCB's staging area (files per namespace), OpenPegasus's registered
modules and compiled files. An SFCB daemon is a copy of sleep under the
daemon's name, so the script's process check sees a real process.

    test_vspr_register.py SCRIPT
"""

import os
import shutil
import subprocess
import sys
import tempfile
import unittest

sys.dont_write_bytecode = True
ROOT = os.path.abspath(os.path.join(os.path.dirname(os.path.abspath(__file__)), "..", ".."))
SCRIPT = None

STUB = r'''#!/bin/sh
name=$(basename "$0")
printf '%s\n' "$name $*" >> "$STUB_DIR/log"
eval "fail=\${STUB_FAIL_$name:-}"
[ -n "$fail" ] && { echo "$name: failing as asked" >&2; exit 1; }
last() { eval "printf '%s' \"\${$#}\""; }
case $name in
sfcbstage|sfcbunstage)
    ns=; reg=
    while [ $# -gt 0 ]; do
        case $1 in -n) ns=$2; shift ;; -r) reg=$2; shift ;; *) mof=$1 ;; esac
        shift
    done
    if [ $name = sfcbstage ]; then
        mkdir -p "$STUB_DIR/stage/$ns" "$STUB_DIR/stage/regs"
        cp "$mof" "$STUB_DIR/stage/$ns/" || exit 1
        [ -z "$reg" ] || cp "$reg" "$STUB_DIR/stage/regs/" || exit 1
    else
        rm "$STUB_DIR/stage/$ns/$(basename "$mof")" || exit 1
        [ -z "$reg" ] || rm "$STUB_DIR/stage/regs/$(basename "$reg")" || exit 1
    fi ;;
cimprovider)
    [ -n "${STUB_PEGASUS_DOWN:-}" ] && { echo "cimprovider: CIM server not running" >&2; exit 1; }
    case $1 in
    -l) cat "$STUB_DIR/modules" 2>/dev/null ;;
    -r) grep -vx "$3" "$STUB_DIR/modules" > "$STUB_DIR/modules.new"
        mv "$STUB_DIR/modules.new" "$STUB_DIR/modules" ;;
    esac ;;
cimmof)
    [ -n "${STUB_PEGASUS_DOWN:-}" ] && exit 1
    file=$(last "$@")
    ns=; while [ $# -gt 0 ]; do [ "$1" = -n ] && ns=$2; shift; done
    mkdir -p "$STUB_DIR/compiled/$ns"
    cp "$file" "$STUB_DIR/compiled/$ns/"
    grep -q "instance of PG_ProviderModule" "$file" &&
        sed -n 's/^ *Name = "\(.*\)";/\1/p' "$file" | head -1 >> "$STUB_DIR/modules" ;;
cimconfig) echo "Current value: $STUB_PROVIDER_DIR" ;;
systemctl) [ "$1" = cat ] && [ "$2" = "${STUB_SERVICE:-sblim-sfcb}" ] && exit 0
    [ "$1" = cat ] && exit 1 ;;
esac
exit 0
'''

TOOLS = ["sfcbstage", "sfcbunstage", "sfcbrepos", "cimmof", "cimprovider", "cimconfig",
         "cimcli", "systemctl"]


class Register(unittest.TestCase):

    def setUp(self):
        self.tmp = tempfile.mkdtemp(prefix="vspr_register_")
        self.stubs = self.path("stubs")
        os.makedirs(self.stubs)
        for tool in TOOLS:
            self.write(os.path.join(self.stubs, tool), STUB, 0o755)
        self.data = self.path("share")
        os.makedirs(self.data)
        for f in ("schema/mof/vespera.mof", "schema/mof/vespera-interop.mof",
                  "schema/vsprprovider.reg", "schema/vsprprovider-pegasus.mof"):
            shutil.copy(os.path.join(ROOT, f), self.data)
        self.modules = self.path("lib", "cmpi")
        os.makedirs(self.modules)
        for f in ("libvsprprovider_Module.so", "libdtruj.so"):
            self.write(os.path.join(self.modules, f), "not really a library\n")
        self.provider_dir = self.path("providers")
        os.makedirs(self.provider_dir)
        self.write(self.path("sfcb.cfg"),
                   "httpPort: 5988\nproviderDirs: %s /usr/lib/sfcb\n" % self.provider_dir)
        self.daemon = None
        self.env = dict(os.environ)
        self.env.update({
            "PATH": self.stubs + ":/usr/bin:/bin",
            "STUB_DIR": self.tmp,
            "STUB_PROVIDER_DIR": self.provider_dir,
            "VSPR_DATA_DIR": self.data,
            "VSPR_MODULE_DIR": self.modules,
            "VSPR_STATE_DIR": self.path("state"),
            "VSPR_SFCB_CONFIG": self.path("sfcb.cfg"),
            # A name no other process has, within the 15 bytes of comm.
            "VSPR_SFCB_DAEMON": "sfcbd%d" % (os.getpid() % 1000000),
        })

    def tearDown(self):
        self.stop_daemon()
        shutil.rmtree(self.tmp, ignore_errors=True)

    def path(self, *parts):
        return os.path.join(self.tmp, *parts)

    @staticmethod
    def write(path, text, mode=0o644):
        with open(path, "w") as f:
            f.write(text)
        os.chmod(path, mode)

    def start_daemon(self):
        exe = self.path(self.env["VSPR_SFCB_DAEMON"])
        shutil.copy(shutil.which("sleep"), exe)
        self.daemon = subprocess.Popen([exe, "60"])

    def stop_daemon(self):
        if self.daemon:
            self.daemon.kill()
            self.daemon.wait()
            self.daemon = None

    def run_script(self, *args, ok=True):
        p = subprocess.run(["sh", SCRIPT] + list(args), env=self.env, capture_output=True,
                           text=True, timeout=60)
        if ok:
            self.assertEqual(0, p.returncode, p.stdout + p.stderr)
        else:
            self.assertNotEqual(0, p.returncode, p.stdout + p.stderr)
        return p

    def calls(self):
        """The stand-ins' calls since the last look, paths shortened."""
        log = self.path("log")
        if not os.path.exists(log):
            return []
        with open(log) as f:
            lines = f.read().splitlines()
        os.remove(log)
        return [line.replace(self.data + "/", "").replace(self.path("state") + "/", "STATE/")
                for line in lines]

    def staged(self):
        out = []
        for base, _, files in os.walk(self.path("stage")):
            out += [os.path.relpath(os.path.join(base, f), self.path("stage")) for f in files]
        return sorted(out)

    def links(self):
        return sorted((f, os.readlink(os.path.join(self.provider_dir, f)))
                      for f in os.listdir(self.provider_dir))

    # --- SFCB ---------------------------------------------------------------

    def test_sfcb_register_twice_then_uninstall(self):
        self.start_daemon()
        expected = [
            "sfcbstage -n root/vespera -r vsprprovider.reg vespera.mof",
            "sfcbstage -n root/interop vespera-interop.mof",
            "sfcbrepos -f",
            "systemctl cat sblim-sfcb",
            "systemctl restart sblim-sfcb",
        ]
        staged = ["regs/vsprprovider.reg", "root/interop/vespera-interop.mof",
                  "root/vespera/vespera.mof"]
        links = [(f, os.path.join(self.modules, f))
                 for f in ("libdtruj.so", "libvsprprovider_Module.so")]
        for _ in range(2):
            out = self.run_script("sfcb").stdout
            self.assertEqual(expected, self.calls())
            self.assertEqual(staged, self.staged())
            self.assertEqual(links, self.links())
            self.assertIn("SFCB serves vsprprovider_Module in root/vespera", out)

        self.run_script("sfcb", "--uninstall")
        self.assertEqual([
            "sfcbunstage -n root/vespera -r vsprprovider.reg vespera.mof",
            "sfcbunstage -n root/interop vespera-interop.mof",
            "sfcbrepos -f",
            "systemctl cat sblim-sfcb",
            "systemctl restart sblim-sfcb",
        ], self.calls())
        self.assertEqual([], self.staged())
        self.assertEqual([], self.links())
        self.assertEqual([], os.listdir(self.path("state")))

        # Taking back twice is no failure: there is only nothing left to do.
        self.run_script("sfcb", "--uninstall")

    def test_sfcb_dry_run_changes_nothing(self):
        self.start_daemon()
        out = self.run_script("sfcb", "--dry-run").stdout
        # Questions only.
        self.assertEqual(["systemctl cat sblim-sfcb"], self.calls())
        self.assertEqual([], self.links())
        self.assertFalse(os.path.exists(self.path("state")))
        for step in ("$ sfcbstage -n root/vespera", "$ sfcbrepos -f", "$ ln -s"):
            self.assertIn(step, out + self.run_script("sfcb", "--dry-run").stderr)

    def test_sfcb_not_running(self):
        p = self.run_script("sfcb", ok=False)
        self.assertIn("isn't running", p.stderr)
        self.assertEqual([], self.calls())
        self.assertEqual([], self.staged())

        # Staged for the next start, with nobody restarted.
        p = self.run_script("sfcb", "--no-restart")
        self.assertEqual(["sfcbstage", "sfcbstage", "sfcbrepos"],
                         [c.split()[0] for c in self.calls()])
        self.assertIn("restart SFCB", p.stdout)

    def test_sfcb_missing_tool(self):
        if shutil.which("sfcbstage", path="/usr/bin:/bin"):
            self.skipTest("a real sfcbstage is installed")
        os.remove(os.path.join(self.stubs, "sfcbstage"))
        self.start_daemon()
        p = self.run_script("sfcb", ok=False)
        self.assertIn("sfcbstage not found", p.stderr)
        self.assertEqual([], self.calls())

    def test_sfcb_leaves_a_foreign_module_file_alone(self):
        self.start_daemon()
        self.write(os.path.join(self.provider_dir, "libvsprprovider_Module.so"), "old copy\n")
        p = self.run_script("sfcb", ok=False)
        self.assertIn("isn't a link", p.stderr)
        self.assertEqual([], self.staged())

    def test_other_interop_namespace(self):
        self.start_daemon()
        self.run_script("sfcb", "--interop-namespace", "interop", "--no-restart")
        self.assertEqual(["interop/vespera-interop.mof", "regs/vsprprovider.reg",
                          "root/vespera/vespera.mof"], self.staged())
        with open(self.path("stage", "regs", "vsprprovider.reg")) as f:
            self.assertNotIn("root/interop", f.read())
        # Registered with one interop namespace, it won't take another on top,
        # and takes back the one it used.
        self.assertIn("--uninstall first", self.run_script("sfcb", ok=False).stderr)
        self.run_script("sfcb", "--uninstall")
        self.assertEqual([], self.staged())

        # A server that loads providers from the module's own directory
        # (among others) needs no link.
        self.env["STUB_PROVIDER_DIR"] = self.path("elsewhere") + ":" + self.modules
        self.run_script("pegasus", "--interop-namespace", "interop")
        with open(self.path("compiled", "interop", "vsprprovider-pegasus.mof")) as f:
            self.assertIn('Namespaces = { "root/vespera", "interop" };', f.read())
        self.assertTrue(os.path.exists(self.path("compiled", "interop", "vespera-interop.mof")))
        self.assertEqual([], self.links())

    # --- OpenPegasus --------------------------------------------------------

    def test_pegasus_register_twice_then_uninstall(self):
        first = [
            "cimprovider -l",
            "cimconfig -g providerDir",
            "cimprovider -l",
            "cimmof -uc -aEV -n root/vespera vespera.mof",
            "cimmof -uc -aEV -n root/PG_InterOp vespera-interop.mof",
            "cimmof -n root/PG_InterOp vsprprovider-pegasus.mof",
        ]
        self.run_script("pegasus")
        self.assertEqual(first, self.calls())
        out = self.run_script("pegasus").stdout
        self.assertEqual(first[:3] + ["cimprovider -r -m vsprprovider_Module"] + first[3:],
                         self.calls())
        self.assertIn("replacing", out)
        with open(self.path("modules")) as f:
            self.assertEqual(["vsprprovider_Module"], f.read().split())
        self.assertEqual(2, len(self.links()))

        self.run_script("pegasus", "--uninstall")
        calls = self.calls()
        self.assertEqual(["cimprovider -l", "cimprovider -l",
                          "cimprovider -r -m vsprprovider_Module"], calls[:3])
        deleted = [c.split()[-2:] for c in calls if c.startswith("cimcli dc")]
        # Subclasses go before their parents, interop namespace first.
        self.assertEqual(["root/PG_InterOp", "VESPERA_SubProfileRequiresProfile"], deleted[0])
        self.assertEqual(["root/vespera", "VESPERA_AgentService"], deleted[14])
        names = [d[1] for d in deleted if d[0] == "root/vespera"]
        self.assertEqual(77, len(names))
        self.assertLess(names.index("VESPERA_EthLoopbackDiagnosticTest"),
                        names.index("VESPERA_DiagnosticTest"))
        self.assertEqual([], self.links())
        with open(self.path("modules")) as f:
            self.assertEqual("", f.read())

    def test_pegasus_not_running_or_missing(self):
        self.env["STUB_PEGASUS_DOWN"] = "1"
        for args in (["pegasus"], ["pegasus", "--uninstall"]):
            p = self.run_script(*args, ok=False)
            self.assertIn("isn't running", p.stderr)
            self.assertEqual(["cimprovider -l"], self.calls())
        del self.env["STUB_PEGASUS_DOWN"]

        if not shutil.which("cimmof", path="/usr/bin:/bin"):
            os.remove(os.path.join(self.stubs, "cimmof"))
            p = self.run_script("pegasus", ok=False)
            self.assertIn("cimmof not found", p.stderr)

    def test_a_failing_step_stops_the_rest(self):
        self.env["STUB_FAIL_cimmof"] = "1"
        p = self.run_script("pegasus", ok=False)
        self.assertIn("failed: cimmof -uc -aEV -n root/vespera", p.stderr)
        self.assertEqual(1, sum(c.startswith("cimmof") for c in self.calls()))
        # What was done before the failure is noted, and taken back.
        self.assertEqual(2, len(self.links()))
        del self.env["STUB_FAIL_cimmof"]
        self.run_script("pegasus", "--uninstall")
        self.assertEqual([], self.links())


if __name__ == "__main__":
    SCRIPT = sys.argv.pop(1)
    unittest.main()
