"""The registrations that the servers read, against what the module exports
and what its class tables say: SFCB's .reg, OpenPegasus's registration
instances, and the class MOF for the interop namespace."""

import os
import re
import sys
import unittest

sys.dont_write_bytecode = True
ROOT = os.path.abspath(os.path.join(os.path.dirname(os.path.abspath(__file__)), "..", ".."))
SCHEMA = os.path.join(ROOT, "schema")

KIND_WORDS = {"Instance": "instance", "Association": "association",
              "Method": "method", "Indication": "indication"}
PEGASUS_TYPES = {"instance": 2, "association": 3, "indication": 4, "method": 5}


def read(*parts):
    with open(os.path.join(ROOT, *parts)) as f:
        return f.read()


def exported_kinds():
    """Provider name -> the MI kinds the module exports an entry for."""
    kinds = {}
    for line in read("cmpi", "generated", "exports.txt").split():
        m = re.match(r"(\w+_Provider)_Create_(\w+)MI$", line)
        if m:
            kinds.setdefault(m.group(1), set()).add(KIND_WORDS[m.group(2)])
    return kinds


def class_flags(cls):
    """The flags of the class table's own record."""
    text = read("schema", cls + ".cpp")
    m = re.search(r'\{ 0, ([A-Z_| ]+), "%s", ' % cls, text)
    if not m:
        raise AssertionError("no class record in schema/%s.cpp" % cls)
    return set(f.strip() for f in m.group(1).split("|"))


def reg_sections():
    """The .reg file as [(class, {key: value})], in file order."""
    sections = []
    for line in read("schema", "vsprprovider.reg").splitlines():
        line = line.split("#", 1)[0].strip()
        if not line:
            continue
        if line.startswith("["):
            sections.append((line.strip("[]"), {}))
        else:
            key, value = line.split(":", 1)
            sections[-1][1][key.strip()] = value.strip()
    return sections


def pegasus_instances():
    """The registration MOF as [(class, {property: value text})]."""
    text = read("schema", "vsprprovider-pegasus.mof")
    text = re.sub(r"//[^\n]*", "", text)
    out = []
    for m in re.finditer(r"^instance of (\w+)\s*\{(.*?)^\};", text, re.S | re.M):
        props = dict((k, v.strip()) for k, v in re.findall(r"(\w+)\s*=\s*([^;]*);", m.group(2)))
        out.append((m.group(1), props))
    return out


def strings(value):
    return re.findall(r'"([^"]*)"', value)


class Registrations(unittest.TestCase):

    @classmethod
    def setUpClass(cls):
        cls.exports = exported_kinds()
        cls.reg = reg_sections()
        cls.pegasus = pegasus_instances()

    def test_reg_names_every_exported_provider_with_its_kinds(self):
        self.assertEqual(76, len(self.reg))
        self.assertEqual(set(self.exports), set(s["provider"] for _, s in self.reg))
        for cls, s in self.reg:
            self.assertEqual(cls + "_Provider", s["provider"])
            self.assertEqual("vsprprovider_Module", s["location"])
            kinds = s["type"].split()
            self.assertEqual(len(kinds), len(set(kinds)), cls)
            self.assertEqual(self.exports[s["provider"]], set(kinds), cls)
            flags = class_flags(cls)
            self.assertEqual("FLAG_ASSOCIATION" in flags, "association" in kinds, cls)
            self.assertEqual("FLAG_INDICATION" in flags, "indication" in kinds, cls)
            self.assertEqual("FLAG_INDICATION" in flags, "instance" not in kinds, cls)

    def test_pegasus_registers_the_same_providers_as_the_reg(self):
        modules = [p for c, p in self.pegasus if c == "PG_ProviderModule"]
        self.assertEqual(1, len(modules))
        module = modules[0]
        self.assertEqual('"vsprprovider_Module"', module["Name"])
        self.assertEqual('"vsprprovider_Module"', module["Location"])
        self.assertEqual('"CMPI"', module["InterfaceType"])
        self.assertEqual('"2.0.0"', module["InterfaceVersion"])

        providers = [strings(p["Name"])[0] for c, p in self.pegasus if c == "PG_Provider"]
        caps = [p for c, p in self.pegasus if c == "PG_ProviderCapabilities"]
        self.assertEqual([s["provider"] for _, s in self.reg], providers)
        self.assertEqual(len(providers), len(caps))
        for (cls, s), cap in zip(self.reg, caps):
            self.assertEqual([cls], strings(cap["ClassName"]))
            self.assertEqual([s["provider"]], strings(cap["ProviderName"]))
            self.assertEqual(['vsprprovider_Module'], strings(cap["ProviderModuleName"]))
            types = sorted(int(t) for t in re.findall(r"\d+", cap["ProviderType"]))
            self.assertEqual(sorted(PEGASUS_TYPES[k] for k in s["type"].split()), types, cls)
            # The same classes in the interop namespace, each server's own.
            reg_ns = s["namespace"].split()
            peg_ns = strings(cap["Namespaces"])
            self.assertEqual("root/vespera", reg_ns[0], cls)
            self.assertEqual("root/vespera", peg_ns[0], cls)
            self.assertEqual(["root/interop"] if len(reg_ns) > 1 else [], reg_ns[1:], cls)
            self.assertEqual(["root/PG_InterOp"] if len(peg_ns) > 1 else [], peg_ns[1:], cls)
        capability_ids = [strings(c["CapabilityID"])[0] for c in caps]
        self.assertEqual(len(capability_ids), len(set(capability_ids)))

    def test_interop_namespace_serves_the_profile_tree(self):
        interop = set(cls for cls, s in self.reg if "root/interop" in s["namespace"].split())
        for cls in ("VESPERA_RegisteredProfile", "VESPERA_RegisteredSubProfile",
                    "VESPERA_ElementConformsToProfile", "VESPERA_SubProfileRequiresProfile",
                    "VESPERA_Namespace", "VESPERA_CIMXMLCommunicationMechanism"):
            self.assertIn(cls, interop)
        # The module asks the interop namespace for the server's own object
        # manager; a provider of ours among the answers would be asked while it
        # waits for them.
        self.assertNotIn("VESPERA_ObjectManager", interop)
        # Nothing of the inventory.
        self.assertNotIn("VESPERA_ComputerSystem", interop)
        self.assertNotIn("VESPERA_FCPort", interop)

    def test_interop_mof_declares_what_it_serves_and_every_class_it_needs(self):
        text = read("schema", "mof", "vespera-interop.mof")
        declared = []
        for m in re.finditer(r"^class (\w+)(?: : (\w+))?\s*\{(.*?)^\};", text, re.S | re.M):
            name, parent, body = m.groups()
            needed = [parent] + re.findall(r"\b(VESPERA_\w+) REF\b", body)
            for n in needed:
                if n and n.startswith("VESPERA_"):
                    self.assertIn(n, declared, "%s needs %s declared before it" % (name, n))
            declared.append(name)
        interop = [cls for cls, s in self.reg if len(s["namespace"].split()) > 1]
        self.assertTrue(set(interop) <= set(declared))
        # Each declaration is the module MOF's, word for word.
        full = read("schema", "mof", "vespera.mof")
        for m in re.finditer(r"^class (\w+).*?^\};\n", text, re.S | re.M):
            self.assertIn(m.group(0), full, m.group(1))


if __name__ == "__main__":
    unittest.main()
