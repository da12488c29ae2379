// What lies in a buffer as it stands in the world, in the colours of its vertices.
uniform mat4 u_ViewProjection;

attribute vec3 a_position;
attribute vec3 a_normal;
attribute vec4 a_colour;
// X and Y of the normal in the space of the shape.
attribute vec2 a_uv;

varying vec4 v_Colour;
varying vec3 v_Normal;
varying vec3 v_LocalNormal;

void main()
{
	v_Colour = a_colour;
	v_Normal = a_normal;
	v_LocalNormal = vec3(a_uv, 0.0);
	gl_Position = u_ViewProjection * vec4(a_position, 1.0);
}
