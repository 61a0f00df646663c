"""The standard qualifiers: what each may stand on, and the type of its value."""

# Names as DSP0004 spells them. c class, a association, p property, r reference, m method, i parameter.
_DECLARED = """
Abstract            boolean   ca
Aggregate           boolean   r
Aggregation         boolean   a
ArrayType           string    pi
Association         boolean   a
BitMap              string[]  pmi
BitValues           string[]  pmi
ClassConstraint     string[]  ca
Correlatable        string[]  p
Counter             boolean   pmi
Deprecated          string[]  caprmi
Description         string    caprmi
DisplayName         string    caprmi
DN                  boolean   pmi
EmbeddedInstance    string    pmi
EmbeddedObject      boolean   pmi
Exception           boolean   c
Experimental        boolean   caprmi
Gauge               boolean   pmi
In                  boolean   i
IsPUnit             boolean   pmi
Key                 boolean   pr
MappingStrings      string[]  caprmi
Max                 integer   r
MaxLen              integer   pmi
MaxValue            integer   pmi
MethodConstraint    string[]  m
Min                 integer   r
MinLen              integer   pmi
MinValue            integer   pmi
ModelCorrespondence string[]  caprmi
NullValue           string    p
OctetString         boolean   pmi
Out                 boolean   i
Override            string    prm
Propagated          string    p
PropertyConstraint  string[]  pr
PUnit               string    pmi
Read                boolean   pr
Required            boolean   prmi
Static              boolean   pm
Terminal            boolean   ca
UMLPackagePath      string    ca
Units               string    pmi
ValueMap            string[]  pmi
Values              string[]  pmi
Version             string    ca
Weak                boolean   r
Write               boolean   pr
"""

# Lower-case name -> (type, scopes).
STANDARD = {name.lower(): (kind, scopes) for name, kind, scopes in
            (line.split() for line in _DECLARED.strip().splitlines())}


def fits(kind: str, value) -> bool:
    """Whether a qualifier's value is of that type."""
    if kind == "boolean":
        return isinstance(value, bool)
    if kind == "string":
        return isinstance(value, str)
    if kind == "integer":
        return isinstance(value, int) and not isinstance(value, bool)
    return isinstance(value, list) and all(isinstance(v, str) for v in value)
