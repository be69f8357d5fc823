"""Tests of the MOF reader and the table generator on small schemas."""

import os
import sys
import tempfile
import unittest

# Keep the source tree free of compiled modules.
sys.dont_write_bytecode = True
sys.path.insert(0, os.path.join(os.path.dirname(os.path.abspath(__file__)), '..', '..', 'tools'))

import gen_cimhost_classes  # noqa: E402
import gen_schema  # noqa: E402
import mof  # noqa: E402

QUALIFIERS = '''
Qualifier Association : boolean = false, Scope(association), Flavor(DisableOverride, ToSubclass);
Qualifier Indication : boolean = false, Scope(class, indication), Flavor(DisableOverride, ToSubclass);
Qualifier Abstract : boolean = false, Scope(class, association, indication), Flavor(EnableOverride, Restricted);
Qualifier Experimental : boolean = false, Scope(any), Flavor(EnableOverride, Restricted);
Qualifier Key : boolean = false, Scope(property, reference), Flavor(DisableOverride, ToSubclass);
Qualifier In : boolean = true, Scope(parameter), Flavor(DisableOverride, ToSubclass);
Qualifier Out : boolean = false, Scope(parameter), Flavor(DisableOverride, ToSubclass);
Qualifier Read : boolean = true, Scope(property);
Qualifier Write : boolean = false, Scope(property);
Qualifier Required : boolean = false, Scope(property, reference, method, parameter), Flavor(DisableOverride, ToSubclass);
Qualifier Override : string = null, Scope(property, reference, method), Flavor(EnableOverride, Restricted);
Qualifier Description : string = null, Scope(any), Flavor(EnableOverride, ToSubclass, Translatable);
Qualifier EmbeddedInstance : string = null, Scope(property, method, parameter);
'''


def model(text, module=()):
    decls, classes = mof.parse_text(QUALIFIERS + text, 'x.mof')
    return gen_schema.Model(decls, classes, set(module))


def feature(m, cls, name):
    c = m.classes[cls.lower()]
    for f, loc in zip(c.features, c.locals):
        if f.name == name:
            return f, loc
    raise KeyError(name)


BASE = '''
[Abstract] class CIM_A {
    [Key] string Id;
    [Experimental, Write] uint16 State = 5;
    string Note;
    uint32 Reset([In, Required(false)] uint16 How, [In(false), Out] CIM_A REF Job);
};
class CIM_B : CIM_A { uint8 Extra; };
[Association] class CIM_L { [Key] CIM_A REF Left; [Key] CIM_A REF Right; };
'''


class ReaderTest(unittest.TestCase):
    def parse(self, text):
        p = mof.Parser(mof.tokenize(text, 't'))
        return p.literal()

    def test_literals(self):
        self.assertEqual('ab"c\n', self.parse(r'"a" "b\"c\n"').value)
        self.assertEqual(-16, self.parse('-0x10').value)
        self.assertEqual(5, self.parse('101b').value)
        self.assertEqual(1.5, self.parse('1.5').value)
        self.assertEqual('x', self.parse("'x'").value)
        arr = self.parse('{ 1, 2 ,3 }')
        self.assertEqual([1, 2, 3], [x.value for x in arr.value])
        self.assertEqual([], self.parse('{}').value)
        self.assertEqual('null', self.parse('NULL').kind)

    def test_errors_name_the_place(self):
        with self.assertRaisesRegex(mof.MofError, r't:2: .*literal'):
            mof.Parser(mof.tokenize('\n;', 't')).literal()
        with self.assertRaisesRegex(mof.MofError, 'unknown escape'):
            mof.tokenize(r'"\q"', 't')

    def test_include_is_relative_to_the_including_file(self):
        with tempfile.TemporaryDirectory() as d:
            os.mkdir(os.path.join(d, 'sub'))
            with open(os.path.join(d, 'top.mof'), 'w') as f:
                f.write('// all\n#pragma include ("sub/a.mof")\nclass B : A { };\n')
            with open(os.path.join(d, 'sub', 'a.mof'), 'w') as f:
                f.write('/* one */ class A { string X[]; sint8 Y[4] = {1, -2}; };')
            _, classes = mof.parse_file(os.path.join(d, 'top.mof'))
        self.assertEqual(['A', 'B'], [c.name for c in classes])
        x, y = classes[0].features
        self.assertEqual((-1, 4), (x.subscript, y.subscript))
        self.assertEqual([1, -2], [v.value for v in y.default.value])


class ModelTest(unittest.TestCase):
    def test_flags_defaults_and_overrides(self):
        m = model(BASE + '''
            class VESPERA_B : CIM_B {
                [Override("State")] uint16 State;
                [Override("Note"), Experimental] string Note = "n";
                string Added;
            };''', ['VESPERA_B'])
        F = gen_schema.FLAG_BIT
        idf, loc = feature(m, 'VESPERA_B', 'Id')
        self.assertEqual(F['property'] | F['key'] | F['read'], idf.flags)
        self.assertEqual(0, loc)
        state, loc = feature(m, 'VESPERA_B', 'State')
        # Experimental doesn't pass to a redeclaration; Write does.
        self.assertEqual(F['property'] | F['read'] | F['write'], state.flags)
        self.assertEqual((1, 5), (loc, state.default.value))
        note, _ = feature(m, 'VESPERA_B', 'Note')
        self.assertTrue(note.flags & F['experimental'])
        self.assertEqual('n', note.default.value)
        names = [f.name for f in m.classes['vespera_b'].features]
        self.assertEqual(['Id', 'State', 'Note', 'Reset', 'Extra', 'Added'], names)
        self.assertEqual([0, 1, 1, 0, 0, 1], m.classes['vespera_b'].locals)

        reset, _ = feature(m, 'CIM_A', 'Reset')
        self.assertEqual(['How', 'Job', 'return_value'], [p.name for p in reset.params])
        how, job, rv = reset.params
        self.assertEqual(F['property'] | F['in'], how.flags)
        self.assertEqual(F['reference'] | F['out'], job.flags)
        self.assertEqual((F['property'] | F['out'], 'uint32'), (rv.flags, rv.type))

    def test_class_kinds(self):
        m = model(BASE + '[Association] class VESPERA_L : CIM_L { };'
                  '[Indication, Abstract] class CIM_I { string S; };'
                  '[Indication] class VESPERA_I : CIM_I { };', ['VESPERA_L', 'VESPERA_I'])
        F = gen_schema.FLAG_BIT
        self.assertEqual(F['class'] | F['abstract'], m.classes['cim_a'].flags)
        self.assertEqual(F['class'], m.classes['cim_b'].flags)
        self.assertEqual(F['association'], m.classes['vespera_l'].flags)
        self.assertEqual(F['indication'], m.classes['vespera_i'].flags)
        # Parents first, the CIM tree's root ahead of the other roots.
        order = [c.name for c in m.order]
        self.assertLess(order.index('CIM_A'), order.index('CIM_B'))
        self.assertLess(order.index('CIM_L'), order.index('VESPERA_L'))
        self.assertEqual(2, m.classes['vespera_l'].num_keys())

    def test_narrowing_but_no_widening_or_retyping(self):
        model(BASE + 'class VESPERA_L : CIM_L { [Override("Left")] CIM_B REF Left; };')
        bad = [
            '[Association] class CIM_M : CIM_L { [Override("Left")] CIM_B REF Left; };'
            '[Association] class VESPERA_M : CIM_M { [Override("Left")] CIM_A REF Left; };',
            'class VESPERA_X : CIM_B { uint32 State; };',
            'class VESPERA_X : CIM_B { string Note[]; };',
            'class VESPERA_X : CIM_B { CIM_A REF Note; };',
            'class VESPERA_X : CIM_B { [Bogus] string S; };',
            'class VESPERA_X : CIM_B { [Key] uint32 M(); };',
            'class VESPERA_X : CIM_B { uint8 S = 256; };',
            'class VESPERA_X : CIM_B { string S; string s; };',
            'class VESPERA_X : CIM_Nowhere { };',
            '[Association] class VESPERA_X { string S; };',
            'class VESPERA_X : CIM_B { string refs; };',
            'class VESPERA_X : CIM_B { uint32 Note(); };',
            'class VESPERA_X : CIM_B { string Reset; };',
            'class VESPERA_X : CIM_B { uint32 M(uint8 delete); };',
        ]
        for text in bad:
            with self.assertRaises(gen_schema.GenError, msg=text):
                model(BASE + text)


class ServerDeclarationTest(unittest.TestCase):
    """A module class may declare, without Override, a feature that the
    catalogue's parent has but a 2.26 Final server's parent lacks."""

    def test_the_tables_keep_the_parents_feature_if_it_says_the_same(self):
        m = model(BASE + '''
            class VESPERA_B : CIM_B {
                [Experimental, Write] uint16 State = 5;
                uint32 Reset([In, Required(false)] uint16 How, [In(false), Out] CIM_A REF Job);
            };''', ['VESPERA_B'])
        self.assertEqual([0] * 5, m.classes['vespera_b'].locals)
        state, _ = feature(m, 'VESPERA_B', 'State')
        self.assertEqual('CIM_A', state.origin)
        for other in ['uint16 State = 6;', '[Write] uint16 State = 5;',
                      'uint32 Reset([In, Out] uint16 How, [In(false), Out] CIM_A REF Job);',
                      'uint32 Reset([In, Required(false)] uint16 How);']:
            with self.assertRaisesRegex(gen_schema.GenError, 'differs', msg=other):
                model(BASE + 'class VESPERA_B : CIM_B { %s };' % other, ['VESPERA_B'])


class ServerTest(unittest.TestCase):
    def compile(self, text):
        decls, classes = mof.parse_text(QUALIFIERS + BASE + text, 'x.mof')
        return gen_cimhost_classes.compile_mof(decls, classes)

    def test_a_server_refuses_what_the_tables_would_take(self):
        self.compile('class X_B : CIM_B { [Override("Note")] string Note; string Own; };')
        for text, why in [
                ('class X_B : CIM_B { [Override("Nothing")] string Nothing; };', 'overrides nothing'),
                ('class X_B : CIM_B { [Override("Id")] string Note; };', 'names'),
                ('class X_B : CIM_B { string Note; };', 'without Override'),
                ('class X_B : CIM_B { [EmbeddedInstance("CIM_Z")] string E; };', 'not a class')]:
            with self.assertRaisesRegex(gen_cimhost_classes.ServerError, why, msg=text):
                self.compile(text)

    def test_description_lists_own_features_with_their_cmpi_types(self):
        text = gen_cimhost_classes.write(
            self.compile('[Association] class X_L : CIM_L { [Override("Left")] CIM_B REF Left; };'),
            'x_classes', 'x.mof')
        self.assertTrue(text.startswith(gen_cimhost_classes.MARKER % 'x.mof' + '\n'))
        self.assertIn('{"Id", CMPI_string, FD_KEY, nullptr, nullptr, 0},', text)
        self.assertIn('{"Job", CMPI_ref, FD_OUT, "CIM_A", nullptr, 0},', text)
        self.assertIn('{"Reset", CMPI_uint32, FD_METHOD, nullptr, p_CIM_A_Reset, 2},', text)
        self.assertIn('{"X_L", "CIM_L", CD_ASSOCIATION, f_X_L, 1},', text)
        self.assertIn('extern const Class_Table x_classes;', text)


class WriterTest(unittest.TestCase):
    def test_literals(self):
        L = mof.Literal
        self.assertEqual('(-9223372036854775807LL - 1)', gen_schema.c_literal('sint64', L('int', -2**63, '')))
        self.assertEqual('18446744073709551615ULL', gen_schema.c_literal('uint64', L('int', 2**64 - 1, '')))
        self.assertEqual(r'"a\"b\\c\n"', gen_schema.c_literal('string', L('string', 'a"b\\c\n', '')))
        self.assertEqual('65', gen_schema.c_literal('char16', L('char', 'A', '')))
        self.assertEqual('0.5f', gen_schema.c_literal('real32', L('real', 0.5, '')))

    def test_output_is_stable_and_marked(self):
        text = BASE + 'class VESPERA_B : CIM_B { string Tags[] = {"a", "b"}; };'
        one = gen_schema.Writer(model(text, ['VESPERA_B'])).files()
        two = gen_schema.Writer(model(text, ['VESPERA_B'])).files()
        self.assertEqual(one, two)
        for name, body in one.items():
            self.assertTrue(body.startswith(gen_schema.MARKER + '\n'), name)
        self.assertIn('static const char* const _VESPERA_B_Tags_elements[] = { "a", "b" };',
                      one['VESPERA_B.cpp'])
        self.assertIn('typedef CIM_A_Reset_method VESPERA_B_Reset_method;', one['VESPERA_B.h'])
        self.assertNotIn('typedef', one['CIM_B.h'])


if __name__ == '__main__':
    unittest.main()
