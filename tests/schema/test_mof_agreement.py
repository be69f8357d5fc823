"""The module's MOF against its tables.

A CIM server compiles the DMTF 2.26 Final files and schema/mof/vespera.mof
into its repository and checks what a provider sets against that; the
module sets what its tables say. Every VESPERA_ class must therefore carry
the same features in both, and where the catalogue puts a class under a
later parent than the 2.26 file, the difference must be one a server can
live with.

Exits 77 (skip) without the DMTF files (VSPR_CIM_SCHEMA_DIR, else the
directory beside the source tree).
"""

import os
import re
import sys
import unittest

# Keep the source tree free of compiled modules.
sys.dont_write_bytecode = True
sys.path.insert(0, os.path.join(os.path.dirname(os.path.abspath(__file__)), '..', '..', 'tools'))

import gen_cimhost_classes  # noqa: E402
import gen_schema  # noqa: E402

SCHEMA = os.environ.get('VSPR_CIM_SCHEMA_DIR') or gen_schema.DEFAULT_SCHEMA
F = gen_schema.FLAG_BIT
EMBEDDED = F['embeddedinstance'] | F['embeddedobject']


def signature(f):
    """What a client or a provider sees of a feature."""
    if f.kind == 'method':
        return ('method', f.type, tuple(
            (p.name.lower(), p.kind, p.type.lower(), p.subscript != 0,
             bool(p.flags & F['in']), bool(p.flags & F['out']), bool(p.flags & EMBEDDED))
            for p in f.params))
    return (f.kind, f.type.lower(), f.subscript != 0, bool(f.flags & F['key']),
            bool(f.flags & EMBEDDED), gen_schema._literal_key(f.default))


def kind(c):
    return c.flags & (F['class'] | F['association'] | F['indication'])


def differences(tables, server):
    """One line for each feature of a VESPERA_ class that the two disagree on."""
    out = []
    for key, t in sorted(tables.classes.items()):
        if not t.name.startswith('VESPERA_'):
            continue
        s = server.classes.get(key)
        if s is None:
            out.append('%s: not on the server' % t.name)
            continue
        if kind(t) != kind(s):
            out.append('%s: of another kind on the server' % t.name)
        tf = {f.name.lower(): f for f in t.features}
        sf = {f.name.lower(): f for f in s.features}
        for name in sorted(set(tf) | set(sf)):
            a, b = tf.get(name), sf.get(name)
            if b is None:
                out.append('%s.%s: only in the tables' % (t.name, a.name))
            elif a is None:
                out.append('%s.%s: only on the server' % (t.name, b.name))
            elif signature(a) != signature(b):
                out.append('%s.%s: tables %r, server %r' % (t.name, a.name, signature(a),
                                                            signature(b)))
    return out


def ancestry(model, name):
    chain = []
    c = model.classes[name.lower()]
    while c is not None:
        chain.append(c.name)
        c = model.classes[c.super.lower()] if c.super else None
    return chain


class Agreement(unittest.TestCase):
    @classmethod
    def setUpClass(cls):
        cls.tables = gen_schema.load(SCHEMA)
        cls.server = gen_cimhost_classes.server_model(SCHEMA)
        cls.module = [c.name for c in cls.tables.order if c.name.startswith('VESPERA_')]

    def test_every_module_class_carries_the_same_features(self):
        self.assertEqual(77, len(self.module))
        self.assertEqual([], differences(self.tables, self.server))

    def test_the_mof_without_a_declaration_is_caught(self):
        with open(gen_schema.MODULE_MOF, encoding='utf-8') as f:
            text = f.read()
        old, n = re.subn(r'\[[^\[]*\]\s*uint16 PortAvailability = 2;', '', text)
        self.assertEqual(1, n)
        server = gen_cimhost_classes.server_model(SCHEMA, module_text=old)
        self.assertEqual(['VESPERA_FCPort.PortAvailability: only in the tables'],
                         differences(self.tables, server))

    def test_ancestries_differ_only_by_the_later_parents(self):
        # The server's chain of each class is the tables' chain without the
        # later parents that the catalogue puts in; where a parent differs,
        # the catalogue moved it deliberately.
        later = set()
        for name in self.module:
            t, s = ancestry(self.tables, name), ancestry(self.server, name)
            self.assertEqual(s, [c for c in t if c in s], name)
            later |= set(t) - set(s)
            for c in s:
                tp = self.tables.classes[c.lower()].super
                sp = self.server.classes[c.lower()].super
                if tp != sp:
                    self.assertEqual(gen_schema.PARENT_FIXES.get(c), tp, c)
        self.assertEqual(set(gen_schema.PARENT_FIXES.values()), later)

        # So a server answers "is a" differently only about those parents. No
        # reference of the module, nor a reference parameter, may name one,
        # or the server would refuse what the tables let through.
        for name in self.module:
            for f in self.server.classes[name.lower()].features:
                refs = [f] + f.params if f.kind == 'method' else [f]
                for r in refs:
                    if r.kind == 'reference':
                        self.assertNotIn(r.type, later, '%s.%s' % (name, r.name))


if __name__ == '__main__':
    if not os.path.isfile(os.path.join(SCHEMA, 'subset.mof')):
        print('test_mof_agreement: %s not found; skipping' % SCHEMA)
        sys.exit(77)
    unittest.main()
