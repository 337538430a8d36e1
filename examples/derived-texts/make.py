#!/usr/bin/env python3
"""What model.xml derives from the answers of every twelfth Chilean, in plain Python."""
import os
import sys

sys.path.insert(0, os.path.join(os.path.dirname(os.path.abspath(__file__)), "..", "fit"))
import derived


def derive(row):
    region, sex, education, vote = row.values()
    group = region + "/" + sex
    return {
        "group": group,
        "group in small letters": group.lower(),
        "vote in small letters": vote.lower(),
        "large again": group.upper(),
        "from the second": group[1:],
        "without its start": education,
        "without its end": education,
        "without its end either": education + "  " + sex,
        "length of the group": len(group),
        "length with blanks": len(education) + 3,
        "label": f"{sex} from {region}; {vote}",
    }


derived.write(__file__, derived.rows_of("chile-tree", ["region", "sex", "education", "vote"], 2), derive)
