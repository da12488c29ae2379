// A sphere so small that it is a point, of the vertex's colour.

// Added to w: from far away the point would fight with the floor for the pixel.
const float c_Nearer = 0.02;
const float c_PointSize = 2.0;

uniform mat4 u_ViewProjection;

attribute vec3 a_position;
attribute vec4 a_colour;

varying vec4 v_Colour;

void main()
{
	v_Colour = a_colour;
	gl_Position = u_ViewProjection * vec4(a_position, 1.0);
	gl_Position.w += c_Nearer;
	gl_PointSize = c_PointSize;
}
