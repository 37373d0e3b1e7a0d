"""The classes of a set of MOF files, resolved: every class with all its features, inherited ones first.

Properties, references and methods keep their declaration order, root class down; an overriding feature takes its
ancestor's place. Everything that the generated code relies on is checked here and reported as a Model_Error.
"""

from dataclasses import dataclass, field

import pywbem

# The flag bit of each qualifier, as runtime/meta.h numbers them.
FLAGS = {
    "Property": 0x1, "Reference": 0x2, "Method": 0x4, "Class": 0x8,
    "Abstract": 0x10, "Aggregate": 0x20, "Aggregation": 0x40, "Association": 0x80,
    "Composition": 0x100, "Counter": 0x200, "Delete": 0x400, "DN": 0x800,
    "EmbeddedObject": 0x1000, "Exception": 0x2000, "Expensive": 0x4000, "Experimental": 0x8000,
    "Gauge": 0x10000, "IfDeleted": 0x20000, "In": 0x40000, "Indication": 0x80000,
    "Invisible": 0x100000, "Key": 0x200000, "Large": 0x400000, "OctetString": 0x800000,
    "Out": 0x1000000, "Read": 0x2000000, "Required": 0x4000000, "Static": 0x8000000,
    "Terminal": 0x10000000, "Weak": 0x20000000, "Write": 0x40000000, "EmbeddedInstance": 0x80000000,
}

# What a subclass has from its superclass, whether or not its MOF repeats it.
INHERITED_CLASS_FLAGS = FLAGS["Association"] | FLAGS["Indication"] | FLAGS["Aggregation"]
INHERITED_FEATURE_FLAGS = FLAGS["Key"]

# The qualifiers that clients ask a server for and whose values the meta-data has no room for.
DOCUMENTED = ("Description", "EmbeddedInstance", "ValueMap", "Values")


class Model_Error(Exception):
    """MOF that compiles and still describes no class that can be generated."""


@dataclass(frozen=True)
class Feature:
    """A property or reference of a class, or a parameter of a method. `type` of a reference is its class's name."""

    name: str
    owner: str  # the class that declares or overrides it
    flags: int
    type: str
    array: int  # 0 scalar, -1 array of any length, n > 0 array of n
    default: object = None
    documentation: dict = field(default_factory=dict)

    @property
    def is_reference(self):
        return bool(self.flags & FLAGS["Reference"])

    @property
    def is_method(self):
        return False

    @property
    def is_key(self):
        return bool(self.flags & FLAGS["Key"])


@dataclass(frozen=True)
class Method:
    """A method; the last parameter is its return_value."""

    name: str
    owner: str
    flags: int
    return_type: str
    parameters: list
    documentation: dict = field(default_factory=dict)

    is_reference = False
    is_method = True
    is_key = False


@dataclass(frozen=True)
class Class:
    name: str
    superclass: "Class | None"
    flags: int
    features: list
    documentation: dict

    @property
    def fields(self):
        """The features that lie in an instance."""
        return [feature for feature in self.features if not feature.is_method]

    @property
    def methods(self):
        return [feature for feature in self.features if feature.is_method]

    def is_local(self, feature):
        return feature.owner == self.name


class _Repository(pywbem.MOFWBEMConnection):
    """Takes the compiled classes in their order. References are checked once all classes are known."""

    def __init__(self):
        super().__init__()
        self.compiled = []

    def CreateClass(self, NewClass, namespace=None):
        known = {compiled.classname.lower() for compiled in self.compiled}
        if NewClass.classname.lower() in known:
            raise pywbem.CIMError(pywbem.CIM_ERR_INVALID_CLASS, f"{NewClass.classname} is declared twice")
        if NewClass.superclass and NewClass.superclass.lower() not in known:
            raise pywbem.CIMError(pywbem.CIM_ERR_INVALID_SUPERCLASS, f"{NewClass.superclass} is not declared")
        self.compiled.append(NewClass)


def load(files, omitted=()):
    """The classes of the files, in their order, but those that are omitted. Raises Model_Error, OSError or pywbem.MOFCompileError."""
    repository = _compiled(files)
    classes = {}
    for compiled in repository.compiled:
        if compiled.classname not in omitted:
            classes[compiled.classname.lower()] = _resolve(compiled, classes)
    result = list(classes.values())
    _check_references(result)
    return result


def load_qualifiers(files):
    """The declarations of qualifiers, as pywbem.CIMQualifierDeclaration, by their names. Raises what load() raises."""
    return sorted(_compiled(files).EnumerateQualifiers(), key=lambda declaration: declaration.name.lower())


def _compiled(files):
    repository = _Repository()
    compiler = pywbem.MOFCompiler(repository, log_func=None)
    for file in files:
        _compile(compiler, str(file))
    return repository


def _compile(compiler, file):
    try:
        compiler.compile_file(file, None)
    except (TypeError, ValueError) as error:  # how the compiler meets a value that does not fit its type
        raise Model_Error(f"{file}: {error}") from error


def _resolve(compiled, classes):
    superclass = classes[compiled.superclass.lower()] if compiled.superclass else None
    flags = _flags(compiled)
    features = []
    if superclass:
        flags |= superclass.flags & INHERITED_CLASS_FLAGS
        features += superclass.features
    if not flags & (FLAGS["Association"] | FLAGS["Indication"]):
        flags |= FLAGS["Class"]

    for declared in [*compiled.properties.values(), *compiled.methods.values()]:
        _add(features, compiled.classname, declared)
    return Class(compiled.classname, superclass, flags, features, _documentation(compiled))


def _add(features, owner, declared):
    """Appends a declared feature, or puts it in the place of the one that it overrides."""
    where = f"{owner}.{declared.name}"
    override = declared.qualifiers.get("Override")
    place = next((i for i, known in enumerate(features) if known.name.lower() == declared.name.lower()), None)

    if override is None:
        if place is not None:
            raise Model_Error(f"{where} has the name of an inherited feature and no Override qualifier")
        features.append(_feature(owner, declared))
        return

    if place is None or str(override.value).lower() != declared.name.lower():
        raise Model_Error(f'{where} overrides "{override.value}", which is not inherited under this name')
    features[place] = _feature(owner, declared, features[place])


def _feature(owner, declared, overridden=None):
    inherited = overridden.flags & INHERITED_FEATURE_FLAGS if overridden else 0
    documentation = {**(overridden.documentation if overridden else {}), **_documentation(declared)}
    if isinstance(declared, pywbem.CIMMethod):
        feature = _method(owner, declared, documentation, overridden)
    else:
        feature = _field(owner, declared, inherited, documentation)
    if overridden and _layout(feature) != _layout(overridden):
        raise Model_Error(f"{owner}.{declared.name} overrides {overridden.owner}.{overridden.name} with another type")
    return feature


def _field(owner, declared, inherited, documentation):
    flags = _flags(declared) | inherited
    if declared.type == "char16" and declared.value is not None:
        raise Model_Error(f"{owner}.{declared.name}: the MOF compiler does not read char16 values")
    if declared.type == "reference":
        return Feature(declared.name, owner, flags | FLAGS["Reference"], declared.reference_class, _array(declared),
                       documentation=documentation)
    read = declared.qualifiers.get("Read")
    if read is None or read.value:
        flags |= FLAGS["Read"]
    return Feature(declared.name, owner, flags | FLAGS["Property"], declared.type, _array(declared), declared.value,
                   documentation)


def _method(owner, declared, documentation, overridden):
    known = {parameter.name.lower(): parameter for parameter in overridden.parameters} if overridden else {}
    parameters = [_parameter(owner, parameter, known.get(name.lower())) for name, parameter in declared.parameters.items()]
    parameters.append(Feature("return_value", owner, FLAGS["Property"] | FLAGS["Out"], declared.return_type, 0))
    return Method(declared.name, owner, _flags(declared) | FLAGS["Method"], declared.return_type, parameters, documentation)


def _parameter(owner, declared, overridden):
    flags = _flags(declared)
    if "In" not in declared.qualifiers:
        flags |= FLAGS["In"]
    documentation = {**(overridden.documentation if overridden else {}), **_documentation(declared)}
    is_reference = declared.type == "reference"
    kind, type_ = ("Reference", declared.reference_class) if is_reference else ("Property", declared.type)
    return Feature(declared.name, owner, flags | FLAGS[kind], type_, _array(declared), documentation=documentation)


def _flags(declared):
    """The bits of the qualifiers that stand on an element itself. EmbeddedInstance names a class: its presence counts."""
    names = {name.lower(): bit for name, bit in FLAGS.items()}
    return sum(names[qualifier.name.lower()] for qualifier in declared.qualifiers.values()
               if qualifier.value and qualifier.name.lower() in names)


def _documentation(declared):
    return {name: declared.qualifiers[name].value for name in DOCUMENTED if name in declared.qualifiers}


def _array(declared):
    if not declared.is_array:
        return 0
    return declared.array_size or -1


def _layout(feature):
    """What must not change when a feature is overridden: its place in an instance."""
    if feature.is_method:
        return "method"
    return "reference" if feature.is_reference else feature.type, feature.array


def _check_references(classes):
    known = {known.name.lower(): known.name for known in classes}
    for owner in classes:
        for feature in owner.features:
            for target in feature.parameters if feature.is_method else [feature]:
                if target.is_reference and known.get(target.type.lower()) != target.type:
                    raise Model_Error(f"{owner.name}.{feature.name} refers to {target.type}, which is not declared")
