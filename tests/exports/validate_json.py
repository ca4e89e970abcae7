#!/usr/bin/env python3
"""Validates JSON documents against a JSON Schema.

Usage: validate_json.py SCHEMA DOCUMENT...

Each document must be strict UTF-8 JSON without duplicate keys and valid
against SCHEMA (whose draft its "$schema" names). So that a validator that
accepts anything cannot pass, each document is also validated once more with
a member that the schema requires removed, which must fail.
"""
import json
import sys

try:
    import jsonschema
except ImportError:
    sys.exit("validate_json: the Python module jsonschema is missing; "
             "scripts/setup.sh installs it (Debian package python3-jsonschema)")


def load(path):
    def no_duplicates(pairs):
        keys = [key for key, _ in pairs]
        duplicates = {key for key in keys if keys.count(key) > 1}
        if duplicates:
            raise ValueError(f"duplicate keys {sorted(duplicates)}")
        return dict(pairs)

    with open(path, encoding="utf-8", errors="strict") as stream:
        return json.load(stream, object_pairs_hook=no_duplicates)


def main():
    if len(sys.argv) < 3:
        sys.exit(__doc__)
    schema = load(sys.argv[1])
    validator_class = jsonschema.validators.validator_for(schema)
    validator_class.check_schema(schema)
    validator = validator_class(schema, format_checker=jsonschema.FormatChecker())
    required = schema["required"][0]
    failed = False
    for path in sys.argv[2:]:
        try:
            document = load(path)
        except (OSError, ValueError) as error:
            print(f"{path}: not strict JSON: {error}")
            failed = True
            continue
        errors = sorted(validator.iter_errors(document), key=lambda e: list(e.path))
        for error in errors[:20]:
            where = "/".join(str(part) for part in error.path)
            print(f"{path}: at /{where}: {error.message[:300]}")
        if errors:
            failed = True
        broken = dict(document)
        broken.pop(required, None)
        if validator.is_valid(broken):
            print(f"{path}: still valid without the required member {required!r}: "
                  "the validator checks nothing")
            failed = True
        if not errors:
            print(f"{path}: valid against {sys.argv[1]}")
    return 1 if failed else 0


if __name__ == "__main__":
    sys.exit(main())
