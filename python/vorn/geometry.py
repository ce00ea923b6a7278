"""The operations of the core, one by one, under snake_case names.

Outputs are returned. Failures are `vorn.ContourError`, whose `code` tells why. Places are pairs
(x, y), measured points triples (x, y, tolerance), contours lists of `Elem`; lengths are in the unit
of the input, angles in radians. Forms for arrays loop in C++.
"""

from vorn._core.geometry import (Elem, ElemType, FittingStrategy, Matrix, SegmentsRelPosition,
                                 add_arc, add_segm, are_points_valid_to_fit,
                                 calc_normalized_3d_vectors, check_poly_self_intersection,
                                 create_fitting_curve, delete_fitting_curve, get_arc_angle_rad,
                                 get_arc_length, get_area, get_circle, get_circle_polygon,
                                 get_deviation, get_elem_point, get_line_polygon,
                                 get_line_segments_intersection, get_lines_intersection,
                                 get_natural_angle, get_outside_max, get_outside_min,
                                 get_permissible_rect, get_signed_deviation,
                                 is_point_valid_to_fit, line_deviations,
                                 line_segments_intersections, linear_equation_system_solve,
                                 lines_intersections, natural_angle_to_azimuth_rad,
                                 natural_angle_to_tangential_azimuth_rad, polygon_areas,
                                 remove_elem, reorth_elements, replace_elem, shift_elem,
                                 split_elem)

__all__ = ["Elem", "ElemType", "FittingStrategy", "Matrix", "SegmentsRelPosition", "add_arc",
           "add_segm", "are_points_valid_to_fit", "calc_normalized_3d_vectors",
           "check_poly_self_intersection", "create_fitting_curve", "delete_fitting_curve",
           "get_arc_angle_rad", "get_arc_length", "get_area", "get_circle", "get_circle_polygon",
           "get_deviation", "get_elem_point", "get_line_polygon",
           "get_line_segments_intersection", "get_lines_intersection", "get_natural_angle",
           "get_outside_max", "get_outside_min", "get_permissible_rect", "get_signed_deviation",
           "is_point_valid_to_fit", "line_deviations", "line_segments_intersections",
           "linear_equation_system_solve", "lines_intersections", "natural_angle_to_azimuth_rad",
           "natural_angle_to_tangential_azimuth_rad", "polygon_areas", "remove_elem",
           "reorth_elements", "replace_elem", "shift_elem", "split_elem"]
