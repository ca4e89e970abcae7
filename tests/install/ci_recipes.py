#!/usr/bin/env python3
"""Checks the CI recipes of docs/ci.md: ci_recipes.py CI_MD ZOR2CHECK ZOR2DESCRIBE EXAMPLE_BUILD.

The two YAML files (GitHub Actions, GitLab CI) must parse and have the shape their service
reads; every zor2check and zor2describe command they or the page's shell blocks run may use
only options that the program's -h text lists; the packages they install must be this
release's; `ctest -L LABEL` must run the example project's interface test; and every file they
publish under build/ must be one that the example project's build wrote there (EXAMPLE_BUILD,
left by the test of the example project).
"""
import os
import re
import shlex
import subprocess
import sys

import yaml

RECIPES = {".github/workflows/interface.yml": "github", ".gitlab-ci.yml": "gitlab"}
SHELL_OPERATORS = {"|", "||", "&&", ";", ">", ">>", "<", "2>", "&"}

problems = []


def blocks(page):
    """(language, file name named just above or None, text) of each fenced block."""
    found = []
    for match in re.finditer(r"(?:^`([^`\n]+)`[^\n]*\n+)?^```(\w+)\n(.*?)^```", page,
                             re.M | re.S):
        found.append((match.group(2), match.group(1), match.group(3)))
    return found


def github_scripts(document, name):
    triggers = document.get("on", document.get(True))
    if not triggers:
        problems.append(f"{name}: no 'on' triggers")
    scripts = []
    for job_name, job in (document.get("jobs") or {}).items():
        if "runs-on" not in job or not isinstance(job.get("steps"), list):
            problems.append(f"{name}: job {job_name} lacks runs-on or steps")
            continue
        for step in job["steps"]:
            if ("run" in step) == ("uses" in step):
                problems.append(f"{name}: a step of {job_name} must have run or uses: {step}")
            if "run" in step:
                scripts.append(step["run"])
    if not document.get("jobs"):
        problems.append(f"{name}: no jobs")
    return scripts


def gitlab_scripts(document, name):
    scripts = []
    jobs = {k: v for k, v in document.items() if isinstance(v, dict) and "script" in v}
    if not jobs:
        problems.append(f"{name}: no job with a script")
    for job_name, job in jobs.items():
        for key in ("before_script", "script", "after_script"):
            entries = job.get(key, [])
            if not isinstance(entries, list) or not all(isinstance(e, str) for e in entries):
                problems.append(f"{name}: {job_name}.{key} must be a list of strings")
                continue
            scripts.extend(entries)
    return scripts


def usage_options(program):
    usage = subprocess.run([program, "-h"], capture_output=True, text=True, check=True).stdout
    return set(re.findall(r"^\s+(--?[A-Za-z][\w-]*)", usage, re.M)) | {"-h", "--help",
                                                                       "--version"}


def check_label(label, example_build):
    """The tests that `ctest -L label` runs include the example project's interface test."""
    listing = subprocess.run(["ctest", "--test-dir", example_build, "-N", "-L", label],
                             capture_output=True, text=True).stdout
    if "geometry_interface" not in listing:
        problems.append(f"ctest -L {label} does not run the interface test of the example "
                        f"project ({example_build})")


def commands(script):
    """The words of each simple command of a shell script (continuations joined)."""
    script = script.replace("\\\n", " ")
    for line in script.splitlines():
        try:
            words = shlex.split(line, comments=True)
        except ValueError:
            continue
        command = []
        for word in words + [";"]:
            if word in SHELL_OPERATORS or word in {"then", "do"}:
                if command:
                    yield command
                command = []
            else:
                command.append(word)


def main():
    page_path, zor2check, zor2describe, example_build = sys.argv[1:5]
    with open(page_path, encoding="utf-8") as f:
        page = f.read()
    options = {"zor2check": usage_options(zor2check),
               "zor2describe": usage_options(zor2describe)}
    version = subprocess.run([zor2check, "--version"], capture_output=True, text=True,
                             check=True).stdout.split()[1]

    scripts = []
    recipes = {}
    for language, file_name, text in blocks(page):
        if language == "yaml":
            if file_name not in RECIPES:
                problems.append(f"a YAML block names no recipe file above it: {file_name}")
                continue
            try:
                document = yaml.safe_load(text)
            except yaml.YAMLError as error:
                problems.append(f"{file_name} does not parse: {error}")
                continue
            recipes[file_name] = text
            if RECIPES[file_name] == "github":
                scripts.extend(github_scripts(document, file_name))
            else:
                scripts.extend(gitlab_scripts(document, file_name))
        elif language == "sh":
            scripts.append(text)
    for file_name in RECIPES:
        if file_name not in recipes:
            problems.append(f"{page_path} has no {file_name}")

    used = {"zor2check": 0, "zor2describe": 0}
    for script in scripts:
        for words in commands(script):
            program = os.path.basename(words[0])
            if program == "ctest" and "-L" in words:
                check_label(words[words.index("-L") + 1], example_build)
            if program not in options:
                continue
            used[program] += 1
            for word in words[1:]:
                if word.startswith("-") and word not in options[program]:
                    problems.append(f"{program} has no option {word}: {' '.join(words)}")
    for program, count in used.items():
        if count == 0:
            problems.append(f"{page_path} runs {program} nowhere")

    everything = "\n".join(recipes.values()) + "\n".join(scripts)
    for package, package_version in re.findall(r"(zor2(?:check|describe))_([^_]+)_amd64\.deb",
                                               everything):
        if package_version != version:
            problems.append(f"the recipes install {package} {package_version}, not {version}")
    # The files published through the variable FINDINGS count as well.
    recipe_text = "\n".join(recipes.values())
    for value in set(re.findall(r"^\s+FINDINGS: (\S+)$", recipe_text, re.M)):
        recipe_text = re.sub(r"\$\{(?:process\.env\.)?FINDINGS\}|\$FINDINGS\b", value, recipe_text)
    published = set(re.findall(r"build/(zor2check/[\w./-]*\w)", recipe_text))
    for path in sorted(published):
        if not os.path.exists(os.path.join(example_build, path)):
            problems.append(f"the recipes publish build/{path}, which the example project's "
                            f"build does not write ({example_build})")

    for problem in dict.fromkeys(problems):
        print(problem)
    sys.exit(1 if problems else 0)


if __name__ == "__main__":
    main()
