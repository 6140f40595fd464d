#!/usr/bin/python3
"""Holds the layout solver beside an independent one, kiwisolver, on random systems.

Both define the answer alike where the weights of kiwisolver's strengths keep its levels apart: a required constraint
that cannot hold beside earlier ones is left out, and each level below has the least sum of errors that the levels above
leave. Sums are compared, not values. Where errors of a stronger level tie, ours goes to the earlier constraint at once,
while kiwisolver asks weaker levels first: such systems are counted and left out. (Debian's python3-kiwisolver belongs to /usr/bin/python3.)

  solver_test.py PROGRAM      1,000 systems; 100,000 with KTR_LONG_TESTS=1
"""
import json
import os
import subprocess
import sys

import kiwisolver

STRENGTHS = {750: "strong", 500: "medium", 250: "weak"}
CLOSE = 1e-5


def residual(constraint, values):
    return sum(factor * values[variable] for variable, factor in constraint["terms"]) - constraint["constant"]


def error(constraint, values):
    missed = residual(constraint, values)
    return {"==": abs(missed), "<=": max(0.0, missed), ">=": max(0.0, -missed)}[constraint["relation"]]


def sums(constraints, values):
    return [sum(error(one, values) for one in constraints if one["level"] == level) for level in STRENGTHS]


def holds_by_itself(constraint):
    relation, constant = constraint["relation"], constraint["constant"]
    return {"==": constant == 0, "<=": constant >= 0, ">=": constant <= 0}[relation]


def answer(system):
    """The values of kiwisolver and which required constraints it could not take."""
    dropped = [one for one in system["constraints"]
               if not one["terms"] and one["level"] == 1000 and not holds_by_itself(one)]
    while True:
        variables = [kiwisolver.Variable(f"v{i}") for i in range(system["variables"])]
        refused = first_refused(variables, [one for one in system["constraints"] if one not in dropped and one["terms"]])
        if refused is None:
            return [variable.value() for variable in variables], dropped
        # A solver that has refused a constraint is not to be used further.
        dropped.append(refused)


def first_refused(variables, constraints):
    solver = kiwisolver.Solver()
    for constraint in sorted(constraints, key=lambda one: -one["level"]):
        expression = sum((factor * variables[index] for index, factor in constraint["terms"]), kiwisolver.Expression([]))
        made = {"==": expression == constraint["constant"], "<=": expression <= constraint["constant"],
                ">=": expression >= constraint["constant"]}[constraint["relation"]]
        try:
            solver.addConstraint(made | STRENGTHS.get(constraint["level"], "required"))
        except kiwisolver.UnsatisfiableConstraint:
            return constraint
    solver.updateVariables()
    return None


def is_compared(line):
    """Whether both define the answer of a system; ends the program where they do and differ."""
    system = json.loads(line)
    values, theirs_dropped = answer(system)
    mine_dropped = [one for one, is_dropped in zip(system["constraints"], system["dropped"]) if is_dropped]
    required = [one for one in system["constraints"] if one["level"] == 1000 and one not in theirs_dropped]
    if any(error(one, values) > CLOSE for one in required):
        return False  # kiwisolver itself misses a constraint that it took
    theirs, mine = sums(system["constraints"], values), sums(system["constraints"], system["values"])
    level = next((i for i, pair in enumerate(zip(mine, theirs)) if abs(pair[0] - pair[1]) > CLOSE), None)
    if level is not None and mine[level] > theirs[level] and any(mine[i] > CLOSE for i in range(level)):
        return False  # a tie in a stronger level, which ours settles before weaker ones are asked
    if level is not None and mine[level] < theirs[level] and any(
            mine[i] - theirs[i] > 900 * (theirs[level] - mine[level]) for i in range(level + 1, len(mine))):
        return False  # beyond a thousand times, kiwisolver gives a stronger level away for a weaker one
    if level is not None or set(map(str, mine_dropped)) != set(map(str, theirs_dropped)):
        sys.exit(f"not alike: sums {mine}, kiwisolver's {theirs}; dropped {mine_dropped}, {theirs_dropped}\n{line}")
    return True


def compared(lines):
    """How many of the systems were compared. In a child process: on some systems kiwisolver aborts its program."""
    reader, writer = os.pipe()
    child = os.fork()
    if child == 0:
        os.close(reader)
        os.write(writer, str(sum(map(is_compared, lines))).encode())
        os._exit(0)
    os.close(writer)
    with os.fdopen(reader) as answers:
        told = answers.read()
    _, status = os.waitpid(child, 0)
    if os.WIFSIGNALED(status):
        if len(lines) == 1:
            return 0
        half = len(lines) // 2
        return compared(lines[:half]) + compared(lines[half:])
    if os.WEXITSTATUS(status) != 0:
        sys.exit(1)
    return int(told)


def main():
    count = 100000 if os.environ.get("KTR_LONG_TESTS") else 1000
    lines = subprocess.run([sys.argv[1], str(count), "20260119"], check=True, stdout=subprocess.PIPE,
                           text=True).stdout.splitlines()
    alike = sum(compared(lines[i:i + 500]) for i in range(0, count, 500))
    print(f"{alike} systems are alike, {count - alike} are defined otherwise there")
    if alike < 0.8 * count:
        sys.exit("too few systems could be compared")


if __name__ == "__main__":
    main()
