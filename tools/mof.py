"""A reader for the subset of MOF that CIM class files use.

It understands qualifier declarations, class declarations (properties,
references, methods and their parameters, default values, arrays) and
`#pragma include`. Instance declarations and other pragmas are not needed by
the generator and are rejected or skipped.
"""

import os
import re


class MofError(Exception):
    pass


_TOKEN = re.compile(r'''
    (?P<ws>[ \t\r\n]+)
  | (?P<lcomment>//[^\n]*)
  | (?P<bcomment>/\*.*?\*/)
  | (?P<string>"(?:[^"\\\n]|\\.)*")
  | (?P<char>'(?:[^'\\\n]|\\.)+')
  | (?P<number>[+-]?(?:0[xX][0-9A-Fa-f]+|[0-9]*\.[0-9]+(?:[eE][+-]?[0-9]+)?|[0-9]+(?:[bB])?))
  | (?P<ident>[A-Za-z_][A-Za-z0-9_]*)
  | (?P<pragma>\#pragma)
  | (?P<punct>[\[\](){},;:=$])
''', re.VERBOSE | re.DOTALL)

_ESCAPES = {'b': '\b', 't': '\t', 'n': '\n', 'f': '\f', 'r': '\r',
            '"': '"', "'": "'", '\\': '\\'}


def _unescape(text, where):
    out = []
    i = 0
    while i < len(text):
        c = text[i]
        if c != '\\':
            out.append(c)
            i += 1
            continue
        i += 1
        if i >= len(text):
            raise MofError('%s: dangling backslash' % where)
        e = text[i]
        if e in _ESCAPES:
            out.append(_ESCAPES[e])
            i += 1
        elif e in 'xX':
            m = re.match(r'[0-9A-Fa-f]{1,4}', text[i + 1:])
            if not m:
                raise MofError('%s: bad \\x escape' % where)
            out.append(chr(int(m.group(0), 16)))
            i += 1 + len(m.group(0))
        else:
            raise MofError('%s: unknown escape \\%s' % (where, e))
    return ''.join(out)


class Token:
    __slots__ = ('kind', 'text', 'value', 'where')

    def __init__(self, kind, text, value, where):
        self.kind = kind
        self.text = text
        self.value = value
        self.where = where

    def __repr__(self):
        return '%s %r' % (self.kind, self.text)


def tokenize(text, path):
    tokens = []
    pos = 0
    line = 1
    while pos < len(text):
        m = _TOKEN.match(text, pos)
        if not m:
            raise MofError('%s:%d: unexpected character %r' % (path, line, text[pos]))
        kind = m.lastgroup
        tok = m.group(kind)
        where = '%s:%d' % (path, line)
        line += tok.count('\n')
        pos = m.end()
        if kind in ('ws', 'lcomment', 'bcomment'):
            continue
        if kind == 'string':
            value = _unescape(tok[1:-1], where)
        elif kind == 'char':
            value = _unescape(tok[1:-1], where)
            if len(value) != 1:
                raise MofError('%s: bad character literal' % where)
        else:
            value = tok
        tokens.append(Token(kind, tok, value, where))
    tokens.append(Token('eof', '', None, '%s:%d' % (path, line)))
    return tokens


class Qualifier:
    """One qualifier as written: its name and value (None if only named)."""
    __slots__ = ('name', 'value')

    def __init__(self, name, value):
        self.name = name
        self.value = value


class QualifierDecl:
    __slots__ = ('name', 'type', 'array', 'default', 'scopes', 'flavors')

    def __init__(self, name, type_, array, default, scopes, flavors):
        self.name = name
        self.type = type_
        self.array = array
        self.default = default
        self.scopes = scopes
        self.flavors = flavors

    def restricted(self):
        return 'restricted' in self.flavors


class Feature:
    """A property, reference, method or parameter.

    kind is 'property', 'reference' or 'method'. For a reference `type` is the
    referenced class; for a method it is the return type. `subscript` is 0
    for a scalar, -1 for an array of any length, else the fixed length.
    """
    __slots__ = ('kind', 'name', 'type', 'subscript', 'default', 'has_default',
                 'qualifiers', 'params', 'where')

    def __init__(self, kind, name, type_, subscript, qualifiers, where):
        self.kind = kind
        self.name = name
        self.type = type_
        self.subscript = subscript
        self.default = None
        self.has_default = False
        self.qualifiers = qualifiers
        self.params = []
        self.where = where


class ClassDecl:
    __slots__ = ('name', 'super', 'qualifiers', 'features', 'path', 'where')

    def __init__(self, name, super_, qualifiers, path, where):
        self.name = name
        self.super = super_
        self.qualifiers = qualifiers
        self.features = []
        self.path = path
        self.where = where


class Literal:
    """A MOF literal: kind is 'string', 'char', 'int', 'real', 'bool',
    'null' or 'array' (value is then a list of Literals)."""
    __slots__ = ('kind', 'value', 'text')

    def __init__(self, kind, value, text):
        self.kind = kind
        self.value = value
        self.text = text


class Parser:
    def __init__(self, tokens):
        self.tokens = tokens
        self.i = 0

    def peek(self, k=0):
        return self.tokens[self.i + k]

    def next(self):
        t = self.tokens[self.i]
        self.i += 1
        return t

    def error(self, msg, tok=None):
        tok = tok or self.peek()
        raise MofError('%s: %s (at %r)' % (tok.where, msg, tok.text))

    def accept(self, text):
        t = self.peek()
        if t.kind in ('punct', 'ident') and t.text.lower() == text.lower() \
                and (t.kind == 'punct' or text[0].isalpha()):
            self.i += 1
            return True
        return False

    def expect(self, text):
        if not self.accept(text):
            self.error('expected %r' % text)

    def ident(self):
        t = self.next()
        if t.kind != 'ident':
            self.error('expected an identifier', t)
        return t.value

    # Literals -----------------------------------------------------------

    def literal(self):
        t = self.peek()
        if t.kind == 'punct' and t.text == '{':
            self.next()
            items = []
            if not self.accept('}'):
                while True:
                    items.append(self.scalar_literal())
                    if self.accept('}'):
                        break
                    self.expect(',')
            return Literal('array', items, None)
        return self.scalar_literal()

    def scalar_literal(self):
        t = self.next()
        if t.kind == 'string':
            parts = [t.value]
            texts = [t.text]
            while self.peek().kind == 'string':
                n = self.next()
                parts.append(n.value)
                texts.append(n.text)
            return Literal('string', ''.join(parts), ' '.join(texts))
        if t.kind == 'char':
            return Literal('char', t.value, t.text)
        if t.kind == 'number':
            s = t.text
            if '.' in s:
                return Literal('real', float(s), s)
            neg = s.startswith('-')
            body = s.lstrip('+-')
            if body[:2] in ('0x', '0X'):
                v = int(body[2:], 16)
            elif body[-1:] in ('b', 'B'):
                v = int(body[:-1], 2)
            else:
                v = int(body, 10)
            return Literal('int', -v if neg else v, s)
        if t.kind == 'ident':
            low = t.text.lower()
            if low in ('true', 'false'):
                return Literal('bool', low == 'true', low)
            if low == 'null':
                return Literal('null', None, 'null')
        if t.kind == 'punct' and t.text == '$':
            self.error('aliases are not supported', t)
        self.error('expected a literal', t)

    # Qualifiers ---------------------------------------------------------

    def qualifier_list(self):
        quals = []
        if not self.accept('['):
            return quals
        while True:
            name = self.ident()
            value = None
            if self.accept('('):
                value = self.literal()
                self.expect(')')
            elif self.peek().kind == 'punct' and self.peek().text == '{':
                value = self.literal()
            if self.accept(':'):
                # Flavors on a qualifier instance: irrelevant to the tables.
                while self.peek().kind == 'ident':
                    self.next()
            quals.append(Qualifier(name, value))
            if self.accept(']'):
                break
            self.expect(',')
        return quals

    def qualifier_decl(self):
        name = self.ident()
        self.expect(':')
        type_ = self.ident().lower()
        array = False
        if self.accept('['):
            array = True
            if self.peek().kind == 'number':
                self.next()
            self.expect(']')
        default = None
        if self.accept('='):
            default = self.literal()
        scopes = []
        flavors = []
        while self.accept(','):
            what = self.ident().lower()
            self.expect('(')
            items = []
            while True:
                items.append(self.ident().lower())
                if self.accept(')'):
                    break
                self.expect(',')
            if what == 'scope':
                scopes = items
            elif what == 'flavor':
                flavors = items
            else:
                self.error('unknown qualifier declaration part %r' % what)
        self.expect(';')
        return QualifierDecl(name, type_, array, default, scopes, flavors)

    # Classes ------------------------------------------------------------

    def subscript(self):
        if not self.accept('['):
            return 0
        if self.peek().kind == 'number':
            n = int(self.next().text)
            self.expect(']')
            return n
        self.expect(']')
        return -1

    def parameter(self):
        quals = self.qualifier_list()
        where = self.peek().where
        type_ = self.ident()
        if self.accept('ref'):
            name = self.ident()
            f = Feature('reference', name, type_, self.subscript(), quals, where)
        else:
            name = self.ident()
            f = Feature('property', name, type_.lower(), self.subscript(), quals, where)
        if self.accept('='):
            f.default = self.literal()
            f.has_default = True
        return f

    def feature(self):
        quals = self.qualifier_list()
        where = self.peek().where
        type_ = self.ident()
        if self.accept('ref'):
            name = self.ident()
            f = Feature('reference', name, type_, self.subscript(), quals, where)
        else:
            name = self.ident()
            if self.accept('('):
                f = Feature('method', name, type_.lower(), 0, quals, where)
                if not self.accept(')'):
                    while True:
                        f.params.append(self.parameter())
                        if self.accept(')'):
                            break
                        self.expect(',')
                self.expect(';')
                return f
            f = Feature('property', name, type_.lower(), self.subscript(), quals, where)
        if self.accept('='):
            f.default = self.literal()
            f.has_default = True
        self.expect(';')
        return f

    def class_decl(self, quals, path):
        where = self.peek().where
        name = self.ident()
        super_ = None
        if self.accept(':'):
            super_ = self.ident()
        cls = ClassDecl(name, super_, quals, path, where)
        self.expect('{')
        while not self.accept('}'):
            cls.features.append(self.feature())
        self.expect(';')
        return cls


def parse_file(path, qualifier_decls=None, classes=None):
    """Parses a MOF file and every file that it includes, in order.

    Returns (qualifier_decls, classes): a dict by lower-case name and a list
    of ClassDecl in the order of the text.
    """
    with open(path, encoding='utf-8') as f:
        text = f.read()
    return parse_text(text, path, qualifier_decls, classes)


def parse_text(text, path, qualifier_decls=None, classes=None):
    """As parse_file, for text that stands in a file named path (includes
    are relative to its directory)."""
    if qualifier_decls is None:
        qualifier_decls = {}
    if classes is None:
        classes = []
    p = Parser(tokenize(text, path))
    while p.peek().kind != 'eof':
        t = p.peek()
        if t.kind == 'pragma':
            p.next()
            what = p.ident().lower()
            p.expect('(')
            arg = p.literal()
            p.expect(')')
            if what == 'include':
                inc = os.path.join(os.path.dirname(path), arg.value)
                parse_file(inc, qualifier_decls, classes)
            continue
        if t.kind == 'ident' and t.text.lower() == 'qualifier':
            p.next()
            d = p.qualifier_decl()
            qualifier_decls[d.name.lower()] = d
            continue
        quals = p.qualifier_list()
        if p.accept('class'):
            classes.append(p.class_decl(quals, path))
            continue
        p.error('expected a qualifier or class declaration')
    return qualifier_decls, classes


def parse_feature(text, path):
    """Parses one feature declaration (property, reference or method)."""
    p = Parser(tokenize(text, path))
    f = p.feature()
    if p.peek().kind != 'eof':
        p.error('expected the end of the feature')
    return f
