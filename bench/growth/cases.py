"""What grows: inventories and rules of any size, and the command that reads them."""
from documents import (KEY, TAIL, array, cls, declared, element, instance, inventory, path, qualifier, reference, rules, value)


def compare(count=2, *options):
    return ['compare', *options, *(f'{number}.xml' for number in range(count))]


# Each case returns its files by name, and the arguments of the command.

def classes(n, args):
    one = inventory(*(cls(f'C{i:06}', declared('A') + declared('B')) + instance(f'C{i:06}', 'x', value('A', 'a')) for i in range(n)))
    return {'0.xml': one, '1.xml': one + ' '}, args


def with_system(n, args):
    """As `classes`, with the operating system that cimdelta otherwise makes."""
    system = cls('KALMO_OperatingSystem', declared('OSType', kind='uint16'), key='Name') + instance(
        'KALMO_OperatingSystem', 's', '<PROPERTY NAME="OSType" TYPE="uint16"><VALUE>36</VALUE></PROPERTY>', 'Name')
    one = classes(n, args)[0]['0.xml'].replace(TAIL, system + TAIL)
    return {'0.xml': one, '1.xml': one}, args


def respelled(n, args):
    def make(prefix, name):
        return inventory(*(cls(f'{prefix}lass{i:06}', declared(name)) + instance(f'{prefix}lass{i:06}', 'x') for i in range(n)))
    return {'0.xml': make('C', 'Size'), '1.xml': make('c', 'size')}, args


def depth(n, args):
    tree = [cls(f'C{i:06}', declared(f'P{i}'), f'C{i - 1:06}' if i else '') for i in range(n)]
    one = inventory(*tree, instance(f'C{n - 1:06}', 'x', value('P0', 'a')))
    return {'0.xml': one, '1.xml': one + ' '}, args


def properties(n, args):
    names = [f'P{i}' for i in range(n)]
    def make(text):
        things = (instance('C', str(i), ''.join(value(name, text + name) for name in names)) for i in range(20))
        return inventory(cls('C', ''.join(declared(name) for name in names)), *things)
    return {'0.xml': make('a'), '1.xml': make('b')}, args


def late_properties(n, args):
    tree = cls('Top', '') + ''.join(cls(f'C{i:03}', '', 'Top') for i in range(50))
    names = ''.join(declared(f'P{i}') for i in range(n))
    return {'0.xml': inventory(tree, instance('C001', 'x')), '1.xml': inventory(tree.replace('</CLASS>', names + '</CLASS>', 1))}, args


def qualifiers(n, args):
    many = ''.join(qualifier(f'Q{i}') for i in range(n))
    one = inventory(*(cls(f'C{i}', declared('A', many), qualifiers=many) + instance(f'C{i}', 'x') for i in range(20)))
    return {'0.xml': one, '1.xml': inventory(cls('Other', ''))}, args


def instances(n, args):
    one = inventory(cls('C', declared('A')), *(instance('C', f'k{i:08}', value('A', f'v{i}')) for i in range(n)))
    return {'0.xml': one, '1.xml': one + ' '}, args


def differences(n, args):
    def make(text):
        return inventory(cls('C', declared('A')), *(instance('C', f'k{i:08}', value('A', text + str(i))) for i in range(n)))
    return {'0.xml': make('a'), '1.xml': make('b')}, args


def missing(n, args):
    def make(text):
        return inventory(cls('C', declared('A')), *(instance('C', f'{text}{i:08}', value('A', 'v')) for i in range(n)))
    return {'0.xml': make('a'), '1.xml': make('b'), '2.xml': make('c')}, args


def inventories(n, classes_of_each=200):
    tree = ''.join(cls(f'C{i:03}', ''.join(declared(f'P{p}') for p in range(12))) for i in range(classes_of_each))
    return {f'{i}.xml': inventory(tree, instance('C000', 'x', value('P0', str(i)))) for i in range(n)}, compare(n)


def own_classes(n, args):
    return {f'{i}.xml': inventory(cls(f'C{i}', declared('A')), instance(f'C{i}', 'x')) for i in range(n)}, compare(n)


def spelled_each(n, args):
    """Every inventory spells the classes in its own way."""
    def spelled(number, i):
        return ''.join(letter.upper() if number >> at & 1 else letter for at, letter in enumerate('someclassname')) + str(i)
    def make(number):
        return inventory(*(cls(spelled(number, i), declared('A')) for i in range(50)), instance(spelled(number, 0), 'x'))
    return {f'{number}.xml': make(number) for number in range(n)}, compare(n)


def one_instance_each(n, args):
    """Every inventory has the same instances and one that no other has."""
    tree = cls('C', declared('A'))
    return {f'{i}.xml': inventory(tree, instance('C', f'own{i}'), instance('C', 'x', value('A', str(i)))) for i in range(n)}, compare(n)


def elements(n, args):
    one = inventory(*(cls(f'C{i:06}', declared('A') + declared('B')) + instance(f'C{i:06}', 'x') for i in range(n)))
    spec = rules(element(f'C{i:06}', lists='<excludelist><value>B</value></excludelist>') for i in range(n))
    return {'0.xml': one, '1.xml': one + ' ', 'rules.xml': spec}, args


def idle_elements(n, args):
    """Elements for classes without instances."""
    one = inventory(*(cls(f'C{i:06}', declared('A')) for i in range(n)), instance('C000000', 'x'))
    return {'0.xml': one, '1.xml': one + ' ', 'rules.xml': rules(element(f'C{i:06}') for i in range(n))}, args


def tree_elements(n, args):
    """A tree in which each class has two below it, and an element for each class, superclasses first."""
    names = [f'C{i:06}' for i in range(n)]
    one = inventory(*(cls(name, declared(f'P{i % 50}'), names[(i - 1) // 2] if i else '') for i, name in enumerate(names)),
                    *(instance(name, 'x') for name in names))
    spec = rules(element(name, lists=f'<excludelist><value>P{i % 50}</value></excludelist>') for i, name in enumerate(names))
    return {'0.xml': one, '1.xml': one + ' ', 'rules.xml': spec}, args


def same_elements(n, args):
    one = inventory(cls('C', declared('A') + declared('B')), instance('C', 'x'))
    return {'0.xml': one, '1.xml': one + ' ', 'rules.xml': rules(element('C') for i in range(n))}, args


def upward_elements(n, args):
    """An element for each class of a line, the lowest first, so that each is overruled."""
    tree = [cls(f'C{i:06}', declared('A') if i == 0 else '', f'C{i - 1:06}' if i else '') for i in range(n)]
    one = inventory(*tree, *(instance(f'C{i:06}', 'x') for i in range(n)))
    spec = rules(element(f'C{i:06}', 'default="include" excludekeys="Id"') for i in reversed(range(n)))
    return {'0.xml': one, '1.xml': one + ' ', 'rules.xml': spec}, args


def listed(n, args):
    names = [f'P{i}' for i in range(n)]
    one = inventory(cls('C', ''.join(declared(name) for name in names)), instance('C', 'x'))
    listing = ''.join(f'<value>{name}</value>' for name in names)
    spec = rules([element('C', 'default="exclude"', f'<includelist>{listing}</includelist>')])
    return {'0.xml': one, '1.xml': one + ' ', 'rules.xml': spec}, args


def excluded_keys(n, args):
    """Elements that exclude keys, for classes whose references then count as reduced."""
    one = inventory(*(cls(f'C{i:06}', '<PROPERTY.REFERENCE NAME="R" REFERENCECLASS="C000000"/>') +
                      instance(f'C{i:06}', 'x', reference('R', 'C000000', 'x')) for i in range(n)))
    spec = rules(element(f'C{i:06}', 'default="include" excludekeys="Id"') for i in range(n))
    return {'0.xml': one, '1.xml': one + ' ', 'rules.xml': spec}, args


def shared_key(n, args, with_reference=True):
    def make(text, count):
        return inventory(cls('C', declared('A')), *(instance('C', f'{text}{i:08}', value('A', f'{text}{i}')) for i in range(count)))
    spec = rules([element('C', 'default="include" excludekeys="Id"')])
    other = inventory(cls('C', declared('A')))
    return {'0.xml': make('a', 1) if with_reference else other, '1.xml': make('b', n), '2.xml': make('c', n), 'rules.xml': spec}, args


def shared_numbers(n, args):
    """Instances that share a key and whose arrays differ."""
    def make(text, count):
        things = (instance('C', f'{text}{i:08}', array('A', [f'{text}{i}', 'z'])) for i in range(count))
        return inventory(cls('C', '<PROPERTY.ARRAY NAME="A" TYPE="string"/>'), *things)
    return {'0.xml': make('a', 1), '1.xml': make('b', n), 'rules.xml': rules([element('C', 'default="include" excludekeys="Id"')])}, args


def references(n, args):
    decl = ''.join(f'<PROPERTY.REFERENCE NAME="R{i}" REFERENCECLASS="C"/>' for i in range(n))
    def make(key):
        things = (instance('C', str(i), ''.join(reference(f'R{r}', 'C', f'{key}{r}') for r in range(n))) for i in range(20))
        return inventory(cls('C', decl), *things)
    return {'0.xml': make('a'), '1.xml': make('b')}, args


def text(n, args):
    def make(letter):
        return inventory(cls('C', declared('A')), instance('C', 'x', value('A', letter * n)))
    return {'0.xml': make('a'), '1.xml': make('b')}, args


def key_text(n, args):
    def make(letter):
        return inventory(cls('C', declared('A')), instance('C', letter * n, value('A', 'a')))
    return {'0.xml': make('a'), '1.xml': make('b')}, args


def escaped(n, args):
    def make(letter):
        return inventory(cls('C', declared('A')), instance('C', '&quot;\\' * n, value('A', letter + '&amp;\n' * n)))
    return {'0.xml': make('a'), '1.xml': make('b')}, args


def array_elements(n, args, ordered=False):
    kind = '<QUALIFIER NAME="ArrayType" TYPE="string"><VALUE>Ordered</VALUE></QUALIFIER>' if ordered else ''
    def make(texts):
        return inventory(cls('C', f'<PROPERTY.ARRAY NAME="A" TYPE="string">{kind}</PROPERTY.ARRAY>'), instance('C', 'x', array('A', texts)))
    return {'0.xml': make([f'v{i:08}' for i in range(n)]), '1.xml': make([f'v{n - i:08}' for i in range(n)])}, args


def ordered_elements(n, args):
    return array_elements(n, args, True)


def types(n, args):
    """A note in the coverage for each class."""
    def make(kind):
        return inventory(*(cls(f'C{i:06}', declared('A', kind=kind)) for i in range(n)), instance('C000000', 'x'))
    return {'0.xml': make('string'), '1.xml': make('uint32')}, args


def many_systems(n, args):
    """Records about an operating system that one inventory lacks."""
    def make(count):
        return inventory(cls('KALMO_OperatingSystem', declared('OSType', kind='uint16'), key='Name'),
                         *(instance('KALMO_OperatingSystem', f's{i:08}', '<PROPERTY NAME="OSType" TYPE="uint16"><VALUE>36</VALUE></PROPERTY>',
                                    'Name') for i in range(count)))
    return {'0.xml': make(n), '1.xml': make(1), '2.xml': make(0)}, args


def like(n, args):
    query = f"SELECT * FROM C WHERE A LIKE '%{'a%' * 10}b'"
    return {'0.xml': inventory(cls('C', declared('A')), instance('C', 'x', value('A', 'a' * n)))}, ['query', query, '0.xml']


def methods(n, args):
    many = ''.join(f'<METHOD NAME="M{i}" TYPE="uint32"><PARAMETER NAME="A" TYPE="string"/></METHOD>' for i in range(n))
    one = inventory(*(cls(f'C{i}', declared('A') + many) + instance(f'C{i}', 'x') for i in range(20)))
    return {'0.xml': one, '1.xml': inventory(cls('Other', ''))}, args


def embedded(n, args):
    """Objects within a value that differ in each of their properties."""
    def make(letter):
        inner = f'<INSTANCE CLASSNAME="Inner">{"".join(value(f"P{i}", letter + str(i)) for i in range(n))}</INSTANCE>'
        whole = f'<PROPERTY NAME="A" TYPE="string" EmbeddedObject="instance"><VALUE><![CDATA[{inner}]]></VALUE></PROPERTY>'
        return inventory(cls('C', declared('A')), *(instance('C', str(i), whole) for i in range(20)))
    return {'0.xml': make('a'), '1.xml': make('b')}, args


def reference_elements(n, args):
    def make(letter):
        values = ''.join(f'<VALUE.REFERENCE>{path("C", letter + str(i))}</VALUE.REFERENCE>' for i in range(n))
        whole = f'<PROPERTY.REFARRAY NAME="R" REFERENCECLASS="C"><VALUE.REFARRAY>{values}</VALUE.REFARRAY></PROPERTY.REFARRAY>'
        return inventory(cls('C', '<PROPERTY.REFARRAY NAME="R" REFERENCECLASS="C"/>'), instance('C', 'x', whole))
    return {'0.xml': make('a'), '1.xml': make('b')}, args


def repeated(n, args):
    """Classes that are declared twice, which is tolerated with a message."""
    one = inventory(*(cls(f'C{i:06}', declared('A')) * 2 for i in range(n)), instance('C000000', 'x'))
    return {'0.xml': one, '1.xml': one + ' '}, args


def conditions(n, args):
    condition = ' OR '.join(f"A = 'w{i}'" for i in range(n))
    return instances(n, [])[0], ['query', f'SELECT * FROM C WHERE {condition}', '0.xml']


CHECK = ['check', 'rules.xml', '--schema', '0.xml', '--schema', '1.xml']
COMPARE_RULES = compare(2, '--spec', 'rules.xml')
EXPLAIN = ['explain', 'C000001', '--schema', '0.xml', '--schema', '1.xml']
SHOW = ['show', '0.xml']
QUERY = ['query', "SELECT * FROM C WHERE A LIKE 'v%9'", '0.xml']

CASES = {
    'classes': (classes, 4000, compare()),
    'classes, 3 inventories': (lambda n, args: (dict(classes(n, args)[0], **{'2.xml': classes(n, args)[0]['0.xml']}), args), 2000, compare(3)),
    'classes, explain': (classes, 4000, EXPLAIN),
    'classes, show': (classes, 8000, SHOW),
    'classes, strict': (with_system, 4000, compare(2, '--strict-schema')),
    'classes spelled anew': (respelled, 4000, compare()),
    'depth of a line of classes': (depth, 200, compare()),
    'depth, explain': (depth, 200, ['explain', 'C000001', '--schema', '0.xml']),
    'depth, show': (depth, 200, SHOW),
    'properties': (properties, 250, compare()),
    'properties, explain': (properties, 250, ['explain', 'C', '--schema', '0.xml']),
    'properties, show': (properties, 250, ['show', '0.xml', 'C']),
    'properties declared late': (late_properties, 250, compare()),
    'properties, show json': (properties, 250, ['show', '-o', 'json', '0.xml', 'C']),
    'properties of an embedded object': (embedded, 250, compare()),
    'methods': (methods, 250, compare()),
    'classes declared twice': (repeated, 4000, compare()),
    'qualifiers': (qualifiers, 250, compare()),
    'instances': (instances, 20000, compare()),
    'instances, show': (instances, 20000, ['show', '0.xml', 'C']),
    'instances, show json': (instances, 20000, ['show', '-o', 'json', '0.xml', 'C']),
    'instances, query': (instances, 20000, QUERY),
    'changed values': (differences, 10000, compare()),
    'changed values, json': (differences, 10000, compare(2, '-o', 'json')),
    'changed values, cimxml': (differences, 10000, compare(2, '-o', 'cimxml')),
    'missing instances': (missing, 10000, compare(3)),
    'inventories of 200 classes': (lambda n, args: inventories(n), 25, None),
    'inventories of 10 classes': (lambda n, args: inventories(n, 10), 100, None),
    'inventories with a class of their own': (own_classes, 50, None),
    'inventories that spell 50 classes anew': (spelled_each, 50, None),
    'inventories with an instance of their own': (one_instance_each, 100, None),
    'elements of rules': (elements, 2000, COMPARE_RULES),
    'elements of rules, check': (elements, 2000, CHECK),
    'elements of rules, check without schema': (elements, 2000, ['check', 'rules.xml']),
    'elements of rules, explain': (elements, 2000, EXPLAIN + ['--spec', 'rules.xml']),
    'elements for classes without instances, check': (idle_elements, 2000, CHECK),
    'elements for classes without instances': (idle_elements, 2000, COMPARE_RULES),
    'elements for a tree of classes, check': (tree_elements, 1000, CHECK),
    'elements for a tree of classes': (tree_elements, 1000, COMPARE_RULES),
    'elements for one class, check': (same_elements, 2000, CHECK),
    'elements for a line of classes, lowest first, check': (upward_elements, 100, CHECK),
    'elements for a line of classes, lowest first': (upward_elements, 100, COMPARE_RULES),
    'elements that exclude keys, check': (excluded_keys, 1000, CHECK),
    'elements that exclude keys': (excluded_keys, 1000, COMPARE_RULES),
    'properties in a list, check': (listed, 250, CHECK),
    'properties in a list': (listed, 250, COMPARE_RULES),
    'properties in a list, explain': (listed, 250, ['explain', 'C', '--spec', 'rules.xml', '--schema', '0.xml']),
    'instances that share a key': (shared_key, 2500, COMPARE_RULES),
    'instances that share a key, json': (shared_key, 2500, compare(2, '-o', 'json', '--spec', 'rules.xml')),
    'instances that share a key, none in the reference': (lambda n, args: shared_key(n, args, False), 1250, compare(3, '--spec', 'rules.xml')),
    'instances that share a key, arrays': (shared_numbers, 1000, COMPARE_RULES),
    'references of an instance': (references, 250, compare()),
    'length of a text': (text, 1000000, compare()),
    'length of a text, show': (text, 1000000, ['show', '0.xml', 'C']),
    'length of a key': (key_text, 1000000, compare()),
    'length of a text to escape': (escaped, 200000, compare()),
    'length of a text to escape, json': (escaped, 200000, compare(2, '-o', 'json')),
    'length of a text, LIKE': (like, 100000, None),
    'references of an array': (reference_elements, 10000, compare()),
    'conditions of a query, and instances': (conditions, 250, None),
    'elements of a bag': (array_elements, 50000, compare()),
    'elements of an ordered array': (ordered_elements, 50000, compare()),
    'notes in the coverage': (types, 4000, compare()),
    'notes in the coverage, json': (types, 4000, compare(2, '-o', 'json')),
    'operating systems': (many_systems, 1000, compare(3)),
}
