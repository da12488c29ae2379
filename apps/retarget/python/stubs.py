"""Prints the types of the package retarget_setup for type checkers, from the package itself.

usage: stubs.py FOLDER      where the built package lies"""
import dataclasses
import enum
import inspect
import sys

sys.path.insert(0, sys.argv[1])
import retarget_setup  # noqa: E402

RETURNS = {
    "read": "SkeletonFile", "compare": "list[Change]", "bones": "list[Bone]", "create": "Session", "load": "Session",
    "edit_kinds": "list[tuple[str, bool, str]]", "write": "None", "check": "list[Finding]", "segment": "Segment",
    "poses": "NDArray[np.float64]", "markers": "NDArray[np.float64]", "rotations": "NDArray[np.float64]",
    "edit": "None", "edits": "None", "targets": "list[dict[str, Any]]", "save": "None", "__init__": "None",
    "__str__": "str", "target": "SkeletonFile", "source": "SkeletonFile | None", "report": "dict[str, Any]",
    "joints": "list[tuple[str, int]]", "joint_poses": "NDArray[np.float64]", "performer": "SkeletonFile",
    "propose": "dict[str, Any]", "align": "dict[str, Any]", "solve": "Solved",
}
TAKES = {
    "path": "_Path", "fbx": "_Path", "source": "_Path | None", "subject": "_Path", "root": "str | None",
    "scale_root_height": "bool", "edits": "_Edits", "version": "str | None", "name": "str", "value": "object",
    "before": "SkeletonFile", "after": "SkeletonFile", "states": "ArrayLike", "file": "SkeletonFile", "text": "str",
    "status": "int", "application_data": "ApplicationData | None",
    "stack": "str | None", "up": "str | None", "unit": "float | None", "rate": "float | None", "take": "Take",
    "first": "int | None", "last": "int | None", "joints": "Iterable[tuple[str, str]]", "rest_frame": "int | None",
    "output": "_Path | None", "chains": "Iterable[str]", "lock": "Iterable[str]",
}


def signature(function, takes=TAKES) -> str:
    words = []
    for name, parameter in inspect.signature(function).parameters.items():
        word = name if name == "self" else f"{name}: {takes[name]}"
        words.append(word if parameter.default is inspect.Parameter.empty else word + " = ...")
    return f"def {function.__name__}({', '.join(words)}) -> {RETURNS[function.__name__]}: ..."


def of_class(made) -> list[str]:
    lines = []
    if issubclass(made, enum.Enum):
        lines = [f"{member.name} = {member.value!r}" for member in made]
        return [f"class {made.__name__}(str, enum.Enum):"] + ["    " + line for line in lines]
    if dataclasses.is_dataclass(made):
        frozen = made.__dataclass_params__.frozen
        for field in dataclasses.fields(made):
            kind = "NDArray[np.float64]" if field.type is object else field.type
            kind = kind if isinstance(kind, str) else kind.__name__
            lines.append(f"{field.name}: {kind}" + ("" if frozen else " = ..."))
        head = ["@dataclasses.dataclass(frozen=True)" if frozen else "@dataclasses.dataclass"]
        return head + [f"class {made.__name__}:"] + ["    " + line for line in lines]
    takes = dict(TAKES, subject="Subject | None", fbx="_Path | None")
    if made is retarget_setup.Error:
        lines.append("status: int")
    if made is retarget_setup.Kinematics:
        lines += ["@property", "def number_of_states(self) -> int: ..."]
        lines += [f"def {name}(self) -> NDArray[np.float64]: ..." for name in ("bind_pose", "mean_pose", "t_pose")]
    if made is retarget_setup.Take:
        lines += ["@property", "def number_of_frames(self) -> int: ...", "@property", "def rate(self) -> float: ..."]
        takes["source"] = "SkeletonFile"
        takes["first"] = "int"
    if made is retarget_setup.SkeletonFile:
        lines += ["subject: Subject", "application_data: ApplicationData"]
    for name, member in vars(made).items():
        if isinstance(member, property):
            lines += ["@property", f"def {name}(self) -> {RETURNS[name]}: ..."]
            if member.fset:
                lines += [f"@{name}.setter", f"def {name}(self, file: {RETURNS[name]}) -> None: ..."]
        elif inspect.isfunction(member) and (name == "__init__" and made is not retarget_setup.Session
                                             or not name.startswith("_")):
            lines.append(signature(member, takes))
    base = "(Exception)" if issubclass(made, Exception) else ""
    return [f"class {made.__name__}{base}:"] + ["    " + line for line in lines]


print("import dataclasses\nimport enum\nimport os\nfrom collections.abc import Iterable\nfrom typing import Any\n")
print("import numpy as np\nfrom numpy.typing import ArrayLike, NDArray\n")
print("_Path = str | bytes | os.PathLike[Any]\n_Edits = Iterable[str | tuple[str, object]]\n\n__version__: str")
for name in sorted(retarget_setup.__all__, key=lambda name: not name.isupper()):
    value = getattr(retarget_setup, name)
    if inspect.isclass(value):
        print("\n" + "\n".join(of_class(value)))
    elif inspect.isfunction(value):
        print("\n" + signature(value))
    else:
        print(f"{name}: {type(value).__name__}")
