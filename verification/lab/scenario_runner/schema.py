"""Holds result documents against their schema, docs/result.schema.json."""

import json
from pathlib import Path

import jsonschema

SCHEMA = json.loads((Path(__file__).resolve().parents[3] / "docs/result.schema.json").read_text(encoding="utf-8"))
_VALIDATOR = jsonschema.Draft202012Validator(SCHEMA)


def _misplaced(error: jsonschema.ValidationError) -> list[list]:
    """The places of what an object holds and should not, or lacks and should hold."""
    here = list(error.absolute_path)
    if error.validator == "required":
        return [here + [key] for key in error.validator_value if key not in error.instance]
    if error.validator == "additionalProperties":
        return [here + [key] for key in error.instance if key not in error.schema["properties"]]
    if "propertyNames" in error.absolute_schema_path:
        return [here + [error.instance]]
    return [here]


def breaches(result: object) -> list[str]:
    """Where the result breaks the schema, sorted."""
    return sorted({"/".join(map(str, place)) for error in _VALIDATOR.iter_errors(result) for place in _misplaced(error)})
