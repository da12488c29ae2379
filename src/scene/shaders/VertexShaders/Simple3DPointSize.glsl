// Points of a size in pixels, in world space.
uniform mat4 u_ViewProjection;
uniform float u_PointSize;

attribute vec3 a_position;

void main()
{
	gl_Position = u_ViewProjection * vec4(a_position, 1.0);
	gl_PointSize = u_PointSize;
}
